#pragma once

#include "Tools/DocTools/VantorPagemeld/System/EnumTable.h"

#include <string>
#include <utility>

// Where the files of a documentation module are, and what they are called: the only page with these names.

template <typename Enum>
struct NameRow
{
    Enum id;
    const char* name;
};

/// The documentation sets, in the order in which they are combined. A set's name is that of its directory.
enum class DocSet
{
    Manual,
    ScriptReference,
    Count,
};

constexpr NameRow<DocSet> kDocSets[] = {{DocSet::Manual, "Manual"},
                                        {DocSet::ScriptReference, "ScriptReference"}};
static_assert(HasRowOfEach(kDocSets));

constexpr const char* NameOf(DocSet set)
{
    return RowOf(kDocSets, set).name;
}

/// The files that a module brings to a set.
enum class Input
{
    Index,
    Toc,
    Count,
};

constexpr NameRow<Input> kInputs[] = {{Input::Index, "index.json"}, {Input::Toc, "toc.json"}};
static_assert(HasRowOfEach(kInputs));

constexpr const char* NameOf(Input input)
{
    return RowOf(kInputs, input).name;
}

/// The files that a module receives in a set, in the order in which they are written.
enum class Output
{
    IndexJson,
    IndexScript,
    TocJson,
    TocScript,
    Count,
};

struct OutputRow
{
    enum class Form
    {
        Json,
        Script, ///< begins with the module's prefix lines
    };

    Output id;
    Form form;
    const char* name;
};

constexpr OutputRow kOutputs[] = {
    {Output::IndexJson, OutputRow::Form::Json, "global_index.json"},
    {Output::IndexScript, OutputRow::Form::Script, "global_index.js"},
    {Output::TocJson, OutputRow::Form::Json, "global_toc.json"},
    {Output::TocScript, OutputRow::Form::Script, "global_toc.js"},
};
static_assert(HasRowOfEach(kOutputs));

/// The directory of all these files, below that of the set.
constexpr const char* kDocdata = "docdata";

/// Returns the name that an output has while it is written.
inline std::string TemporaryPathOf(const std::string& path)
{
    return path + ".tmp";
}

/// Returns the path of an input below the directory of its set.
inline std::string PathInSet(Input input)
{
    return std::string(kDocdata) + "/" + NameOf(input);
}

/// The directory of one documentation set of one module, such as "docs/charts/Manual". Paths are joined as
/// they are typed; none is normalised, so a root that ends in '/' gives two of them in a row.
class ModulePath
{
public:
    explicit ModulePath(std::string path) : m_path(std::move(path)) {}
    ModulePath(const std::string& root, const std::string& setName) : m_path(root + "/" + setName) {}
    ModulePath(const std::string& root, DocSet set) : ModulePath(root, NameOf(set)) {}

    [[nodiscard]] const std::string& Text() const { return m_path; }

    /// Returns the path with a '/' after it, the form in which prefixes lead to it.
    [[nodiscard]] std::string AsLinkTarget() const { return m_path + "/"; }

    /// Returns the path of a file below it, such as PathInSet.
    [[nodiscard]] std::string File(const std::string& name) const { return m_path + "/" + name; }

    [[nodiscard]] std::string Docdata() const { return File(kDocdata); }
    [[nodiscard]] std::string PathOf(Input input) const { return File(PathInSet(input)); }
    [[nodiscard]] std::string PathOf(const OutputRow& output) const { return Docdata() + "/" + output.name; }

private:
    std::string m_path;
};
