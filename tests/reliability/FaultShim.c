/* Preloaded into molvar-convert by the fault tests: makes files in one folder fail the way a full
 * disk, a folder without write permission or a file cut short by another program does. Plain C,
 * built without sanitizers; a sanitized executable accepts it with verify_asan_link_order=0.
 *
 * MOLVAR_FAULT_DIR             the folder whose files are affected (an absolute, real path)
 * MOLVAR_FAULT_WRITE_BUDGET    bytes fwrite() may still put into files there; beyond it, ENOSPC
 * MOLVAR_FAULT_CLOSE_ENOSPC    "1": closing a file written there reports ENOSPC (late allocation)
 * MOLVAR_FAULT_DENY_CREATE     "1": creating a file there fails with EACCES, even for root
 * MOLVAR_FAULT_TRUNCATE_PATH   a file that is cut to MOLVAR_FAULT_TRUNCATE_TO bytes right after
 *                              the first fread() from it returned data
 *
 * stdio is interposed rather than write(): glibc's stdio calls its internal write, which no
 * preloaded library can replace. */
#define _GNU_SOURCE
#include <dlfcn.h>
#include <errno.h>
#include <fcntl.h>
#include <limits.h>
#include <stdarg.h>
#include <stdio.h>
#include <stdlib.h>
#include <string.h>
#include <sys/stat.h>
#include <unistd.h>

/* The next definition of a function; through memcpy since ISO C has no cast from an object
 * pointer to a function pointer. */
#define NEXT(real, name)                        \
  do {                                          \
    if (real == NULL) {                         \
      void* symbol = dlsym(RTLD_NEXT, name);    \
      memcpy(&real, &symbol, sizeof real);      \
    }                                           \
  } while (0)

static const char* env(const char* name) {
  const char* v = getenv(name);
  return v != NULL && *v != '\0' ? v : NULL;
}

/* Whether `path` names an entry directly inside MOLVAR_FAULT_DIR. */
static int in_fault_dir(const char* path) {
  const char* dir = env("MOLVAR_FAULT_DIR");
  if (dir == NULL || path == NULL) return 0;
  const size_t n = strlen(dir);
  return strncmp(path, dir, n) == 0 && path[n] == '/' && strchr(path + n + 1, '/') == NULL;
}

static int fd_in_fault_dir(int fd) {
  char link[64], path[PATH_MAX];
  snprintf(link, sizeof link, "/proc/self/fd/%d", fd);
  const ssize_t len = readlink(link, path, sizeof path - 1);
  if (len <= 0) return 0;
  path[len] = '\0';
  return in_fault_dir(path);
}

static int denied(const char* path, int creating) {
  return creating && env("MOLVAR_FAULT_DENY_CREATE") != NULL && in_fault_dir(path);
}

static long long budget_left = -2; /* -2: not read yet, -1: no budget */

static long long budget(void) {
  if (budget_left == -2) {
    const char* v = env("MOLVAR_FAULT_WRITE_BUDGET");
    budget_left = v != NULL ? atoll(v) : -1;
  }
  return budget_left;
}

int open(const char* path, int flags, ...) {
  static int (*real)(const char*, int, ...);
  NEXT(real, "open");
  mode_t mode = 0;
  if (flags & (O_CREAT | O_TMPFILE)) {
    va_list ap;
    va_start(ap, flags);
    mode = (mode_t)va_arg(ap, int);
    va_end(ap);
  }
  if (denied(path, (flags & O_CREAT) != 0)) {
    errno = EACCES;
    return -1;
  }
  return real(path, flags, mode);
}

int open64(const char* path, int flags, ...) {
  static int (*real)(const char*, int, ...);
  NEXT(real, "open64");
  mode_t mode = 0;
  if (flags & (O_CREAT | O_TMPFILE)) {
    va_list ap;
    va_start(ap, flags);
    mode = (mode_t)va_arg(ap, int);
    va_end(ap);
  }
  if (denied(path, (flags & O_CREAT) != 0)) {
    errno = EACCES;
    return -1;
  }
  return real(path, flags, mode);
}

static FILE* truncate_target = NULL;

static FILE* opened(FILE* f, const char* path, const char* mode) {
  const char* cut = env("MOLVAR_FAULT_TRUNCATE_PATH");
  if (f != NULL && cut != NULL && strcmp(path, cut) == 0 && mode[0] == 'r') truncate_target = f;
  return f;
}

FILE* fopen(const char* path, const char* mode) {
  static FILE* (*real)(const char*, const char*);
  NEXT(real, "fopen");
  if (denied(path, mode[0] == 'w' || mode[0] == 'a')) {
    errno = EACCES;
    return NULL;
  }
  return opened(real(path, mode), path, mode);
}

FILE* fopen64(const char* path, const char* mode) {
  static FILE* (*real)(const char*, const char*);
  NEXT(real, "fopen64");
  if (denied(path, mode[0] == 'w' || mode[0] == 'a')) {
    errno = EACCES;
    return NULL;
  }
  return opened(real(path, mode), path, mode);
}

size_t fread(void* data, size_t size, size_t count, FILE* f) {
  static size_t (*real)(void*, size_t, size_t, FILE*);
  NEXT(real, "fread");
  const size_t got = real(data, size, count, f);
  if (f == truncate_target && got > 0) {
    truncate_target = NULL;
    const char* to = env("MOLVAR_FAULT_TRUNCATE_TO");
    /* By name: the descriptor is open for reading only. */
    if (truncate(env("MOLVAR_FAULT_TRUNCATE_PATH"), to != NULL ? atoll(to) : 0) != 0) abort();
  }
  return got;
}

size_t fwrite(const void* data, size_t size, size_t count, FILE* f) {
  static size_t (*real)(const void*, size_t, size_t, FILE*);
  NEXT(real, "fwrite");
  if (size == 0 || budget() < 0 || !fd_in_fault_dir(fileno(f))) return real(data, size, count, f);
  const unsigned long long wanted = (unsigned long long)size * count;
  if (wanted <= (unsigned long long)budget_left) {
    budget_left -= (long long)wanted;
    return real(data, size, count, f);
  }
  const size_t items = (size_t)budget_left / size;
  const size_t done = items > 0 ? real(data, size, items, f) : 0;
  budget_left -= (long long)(done * size);
  errno = ENOSPC;
  return done;
}

int fclose(FILE* f) {
  static int (*real)(FILE*);
  NEXT(real, "fclose");
  const int late = env("MOLVAR_FAULT_CLOSE_ENOSPC") != NULL && fd_in_fault_dir(fileno(f));
  if (f == truncate_target) truncate_target = NULL;
  const int result = real(f);
  if (late && result == 0) {
    errno = ENOSPC;
    return EOF;
  }
  return result;
}
