#pragma once
// A 24-byte string for the per-point texts: up to 23 characters live inside the object, so the
// usual timestamp ("yyyy-mm-dd hh:nn:ss AM/PM", 22 characters) needs no heap allocation.
#include <cstdint>
#include <cstring>
#include <string>
#include <string_view>

namespace molvar {

class CompactString {
 public:
  CompactString() { Clear(); }
  CompactString(std::string_view s) { Init(s); }  // NOLINT: implicit by design, like std::string
  CompactString(const CompactString& other) { Init(other.view()); }
  CompactString(CompactString&& other) noexcept {
    std::memcpy(raw_, other.raw_, sizeof raw_);
    other.Clear();
  }
  CompactString& operator=(const CompactString& other) {
    if (this != &other) Assign(other.view());
    return *this;
  }
  CompactString& operator=(CompactString&& other) noexcept {
    if (this != &other) {
      Release();
      std::memcpy(raw_, other.raw_, sizeof raw_);
      other.Clear();
    }
    return *this;
  }
  CompactString& operator=(std::string_view s) {
    Assign(s);
    return *this;
  }
  ~CompactString() { Release(); }

  std::string_view view() const {
    if (IsHeap()) {
      char* p = nullptr;
      uint32_t n = 0;
      std::memcpy(&p, raw_, sizeof p);
      std::memcpy(&n, raw_ + sizeof p, sizeof n);
      return {p, n};
    }
    return {reinterpret_cast<const char*>(raw_), raw_[kTag]};
  }
  operator std::string_view() const { return view(); }  // NOLINT
  std::string str() const { return std::string(view()); }
  bool empty() const { return view().empty(); }
  std::size_t size() const { return view().size(); }

  void Assign(std::string_view s) {
    Release();
    Init(s);
  }

  friend bool operator==(const CompactString& a, std::string_view b) { return a.view() == b; }
  friend bool operator==(const CompactString& a, const CompactString& b) { return a.view() == b.view(); }

 private:
  static constexpr std::size_t kInline = 23;
  static constexpr std::size_t kTag = 23;
  static constexpr unsigned char kHeapTag = 0xFF;

  bool IsHeap() const { return raw_[kTag] == kHeapTag; }
  void Clear() {
    std::memset(raw_, 0, sizeof raw_);
  }
  void Init(std::string_view s) {
    Clear();
    if (s.size() <= kInline) {
      if (!s.empty()) std::memcpy(raw_, s.data(), s.size());
      raw_[kTag] = static_cast<unsigned char>(s.size());
      return;
    }
    char* p = new char[s.size()];  // owned by this object; freed in Release()
    std::memcpy(p, s.data(), s.size());
    const auto n = static_cast<uint32_t>(s.size());
    std::memcpy(raw_, &p, sizeof p);
    std::memcpy(raw_ + sizeof p, &n, sizeof n);
    raw_[kTag] = kHeapTag;
  }
  void Release() {
    if (IsHeap()) {
      char* p = nullptr;
      std::memcpy(&p, raw_, sizeof p);
      delete[] p;
    }
    Clear();
  }

  alignas(8) unsigned char raw_[24];
};

}  // namespace molvar
