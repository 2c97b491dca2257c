#pragma once

#include <string>

#include <dirent.h>

/// Owns the entries of a directory in the byte order of their names; none if it can't be listed.
class SortedListing
{
public:
    explicit SortedListing(const char* directory);
    ~SortedListing();

    SortedListing(const SortedListing&) = delete;
    SortedListing& operator=(const SortedListing&) = delete;

    [[nodiscard]] bool Failed() const { return m_count < 0; }
    [[nodiscard]] dirent* const* begin() const { return m_entries; }
    [[nodiscard]] dirent* const* end() const { return m_count > 0 ? m_entries + m_count : m_entries; }

private:
    dirent** m_entries = nullptr;
    int m_count;
};

/// Whether the entry at path is a directory itself, and not a link to one. Asks the file system only if
/// the listing does not say.
bool IsDirectoryItself(const dirent& entry, const std::string& path);
