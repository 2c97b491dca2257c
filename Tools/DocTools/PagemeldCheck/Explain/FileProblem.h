#pragma once

#include <string>

// Why a program that runs as this user can't use a file or directory, asked of the system and not tried out:
// the checker changes nothing on disk.

/// Returns why the file at path, which could not be read whole, is refused: "is a directory", "can't be read:
/// permission denied".
std::string DescribeUnreadable(const std::string& path);

/// Returns why no file can be made in the directory at path, such as "is missing", or an empty text.
std::string DescribeUnwritableDirectory(const std::string& path);

/// Returns what keeps a file from being opened at path for reading and writing, made if it is not there: "a
/// directory", "a link into a missing directory"; an empty text if nothing does.
std::string DescribeObstacle(const std::string& path);

/// Whether the entry at path can't be renamed or replaced by this user: it and its directory belong to
/// others, and the directory's sticky bit reserves it for its owner.
bool IsReservedForOwner(const std::string& directory, const std::string& path);
