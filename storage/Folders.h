#pragma once

#include <string>
#include <sys/types.h>
#include <system_error>

/// The folder that holds the file or folder at `path`; "." for a bare name.
std::string folderOf(const std::string& path);

/// Makes the folder at `path`, and those above it, unless they are there; what was made is on the disk on return.
/// @param mode of each folder that is made, less the user's mask.
/// @return the reason when there is no such folder in the end.
std::error_code makeFolders(const std::string& path, mode_t mode = 0777);

/// Brings the names in a folder to the disk. Some file systems cannot do that, and it is no failure there: a file whose
/// bytes are on the disk is whole under whichever name it is found.
void syncFolder(const std::string& path);
