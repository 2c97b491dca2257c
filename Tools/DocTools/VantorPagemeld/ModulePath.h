#pragma once

#include <string>
#include <utility>

// Where the files of a module are, below the directory of one documentation set.

constexpr const char* kIndexInput = "docdata/index.json";
constexpr const char* kTocInput = "docdata/toc.json";
constexpr const char* kIndexJsonOutput = "docdata/global_index.json";
constexpr const char* kIndexScriptOutput = "docdata/global_index.js";
constexpr const char* kTocJsonOutput = "docdata/global_toc.json";
constexpr const char* kTocScriptOutput = "docdata/global_toc.js";

/// The directory of one documentation set of one module, such as "docs/charts/Manual". Paths are joined as
/// they are typed; none is normalised, so a root that ends in '/' gives two of them in a row.
class ModulePath
{
public:
    explicit ModulePath(std::string path) : m_path(std::move(path)) {}
    ModulePath(const std::string& root, const std::string& setName) : m_path(root + "/" + setName) {}

    [[nodiscard]] const std::string& Text() const { return m_path; }

    /// Returns the path with a '/' after it, the form in which prefixes lead to it.
    [[nodiscard]] std::string AsLinkTarget() const { return m_path + "/"; }

    /// Returns the path of a file below it, such as kIndexInput.
    [[nodiscard]] std::string File(const std::string& name) const { return m_path + "/" + name; }

private:
    std::string m_path;
};
