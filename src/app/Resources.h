#pragma once
// The files the program folder needs beside the settings: icons, the speed legend, samples.
#include <string>

namespace molvar {

// Copies every file under `resourceDir` (keeping its sub-folders) into `programFolder` where that
// file is missing. A file already there is the user's and is never replaced, except the help pages
// under Help/, which are the program's own and are brought up to date. Files that cannot be
// copied are left out; the writers refer to them by path and Google Earth shows a blank icon.
void InstallResources(const std::string& programFolder, const std::string& resourceDir = MOLVAR_RESOURCE_DIR);

}  // namespace molvar
