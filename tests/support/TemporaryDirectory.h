#pragma once

#include <cstdlib>
#include <filesystem>
#include <string>

/// A new empty directory that is removed, with its contents, at the end of this object's life.
class TemporaryDirectory
{
public:
    TemporaryDirectory() : m_path(std::filesystem::temp_directory_path() / "pagemeld-test-XXXXXX")
    {
        if (::mkdtemp(m_path.data()) == nullptr)
        {
            throw std::filesystem::filesystem_error("no temporary directory", m_path, {});
        }
    }

    ~TemporaryDirectory()
    {
        std::error_code ignored;
        std::filesystem::remove_all(m_path, ignored);
    }

    TemporaryDirectory(const TemporaryDirectory&) = delete;
    TemporaryDirectory& operator=(const TemporaryDirectory&) = delete;

    [[nodiscard]] const std::string& Path() const { return m_path; }

    /// Returns the path of something below the directory.
    [[nodiscard]] std::string operator/(const std::string& name) const { return m_path + "/" + name; }

private:
    std::string m_path;
};
