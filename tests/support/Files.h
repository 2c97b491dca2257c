#pragma once

#include <filesystem>
#include <fstream>
#include <iterator>
#include <map>
#include <string>

/// Returns all bytes of a file, or a text that says that it can't be opened.
inline std::string ReadFile(const std::string& path)
{
    std::ifstream file(path, std::ios::binary);
    return file ? std::string(std::istreambuf_iterator<char>(file), {}) : "(no file " + path + ")";
}

/// Writes a file, and makes the directories above it that are missing.
inline void WriteFile(const std::string& path, const std::string& bytes)
{
    std::filesystem::create_directories(std::filesystem::path(path).parent_path());
    std::ofstream(path, std::ios::binary) << bytes;
}

/// Returns the content of every regular file below a directory, by its path relative to that.
inline std::map<std::string, std::string> ReadTree(const std::string& directory)
{
    std::map<std::string, std::string> files;
    for (const auto& entry : std::filesystem::recursive_directory_iterator(directory))
    {
        if (entry.is_regular_file())
        {
            files[entry.path().lexically_relative(directory)] = ReadFile(entry.path());
        }
    }
    return files;
}
