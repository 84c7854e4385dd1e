/// \file
/// Where files are kept in memory, for tests that make them by the thousand.

#ifndef TESTS_SUPPORT_MEMORY_FOLDER_POSIX_H
#define TESTS_SUPPORT_MEMORY_FOLDER_POSIX_H

#include <filesystem>
#include <unistd.h>

/// \return the folder for temporary files if the system keeps none in memory
inline std::filesystem::path memoryFolder() {
    return ::access("/dev/shm", W_OK) == 0 ? "/dev/shm" : std::filesystem::temp_directory_path();
}

#endif
