#include "Tools/DocTools/PagemeldCheck/InputCheck.h"

#include "Tools/DocTools/PagemeldCheck/Explain/FaultText.h"
#include "Tools/DocTools/PagemeldCheck/Explain/ParseFailure.h"
#include "Tools/DocTools/PagemeldCheck/Explain/ShownText.h"
#include "Tools/DocTools/VantorPagemeld/Check/IndexStructure.h"
#include "Tools/DocTools/VantorPagemeld/Check/TocStructure.h"
#include "Tools/DocTools/VantorPagemeld/Read/InputFile.h"
#include "Tools/DocTools/VantorPagemeld/Read/JsonDocument.h"
#include "Tools/DocTools/VantorPagemeld/Read/JsonReader.h"

#include <cstring>

namespace
{

using rapidjson::Value;

/// Whether an entry of pages has the form that only the combined index has: a third element, the module.
bool IsMergedPage(const Value& entry)
{
    return entry.IsArray() && entry.Size() == 3 && entry[2].IsInt();
}

/// One file while it is checked.
class InputCheck
{
public:
    InputCheck(const FileScope& scope, const std::string& moduleName, const Value& document)
        : m_findings(scope), m_moduleName(moduleName), m_document(document)
    {
    }

    FileFindings& Findings() { return m_findings; }

    /// Looks at the bytes that no parser sees as a fault.
    void CheckBytes(std::string_view seen, std::size_t size)
    {
        const std::size_t invalid = FindInvalidUtf8(seen);
        if (invalid != std::string_view::npos)
        {
            m_findings.AddAtOffset("invalid-utf8", invalid,
                                   "byte " + Visible(seen.substr(invalid, 1)) +
                                       " is not UTF-8: readers see a replacement character");
        }
        if (seen.size() + 1 < size)
        {
            m_findings.AddAtOffset("text-after-nul", seen.size(),
                                   "a NUL byte ends the text; bytes after it that are not seen: " +
                                       std::to_string(size - seen.size() - 1));
        }
    }

    void ReportRefusal(InputKind kind, std::string_view seen, std::size_t size,
                       const rapidjson::ParseResult& failure)
    {
        m_findings.AddAtOffset("not-json", failure.Offset(),
                               DescribeParseFailure(seen, size, failure) + Consequence(kind));
    }

    /// Returns whether the tool takes the document.
    bool CheckIndex()
    {
        bool isMerged = false;
        bool isSound = true;
        CheckIndexStructure(m_document,
                            [&](const StructureFault& fault, const JsonPointer& pointer, const Value& value)
                            {
                                isSound = false;
                                if (fault.number == kPageNotPairNumber && IsMergedPage(value))
                                {
                                    ReportMergedPage(std::exchange(isMerged, true), pointer, value);
                                    return true;
                                }
                                const auto wording = [&]
                                {
                                    return DescribeIndexFault(fault, pointer, value, m_document,
                                                              QuoteSize()) +
                                           Consequence(InputKind::Index);
                                };
                                m_findings.AddAtValue("structure", value, pointer, wording);
                                return true;
                            });
        return isSound;
    }

    bool CheckToc()
    {
        bool isSound = true;
        CheckTocStructure(m_document,
                          [&](const StructureFault& fault, const JsonPointer& pointer, const Value& value)
                          {
                              isSound = false;
                              const auto wording = [&] {
                                  return DescribeTocFault(fault, pointer, value, QuoteSize()) +
                                         Consequence(InputKind::Toc);
                              };
                              m_findings.AddAtValue("structure", value, pointer, wording);
                              return true;
                          });
        (void)ReportTaggedNode(m_document, JsonPointer(), isSound);
        return isSound;
    }

private:
    static constexpr int kPageNotPairNumber = 318;

    [[nodiscard]] std::size_t QuoteSize() const { return m_findings.Scope().quoteSize; }

    [[nodiscard]] std::string Consequence(InputKind kind) const
    {
        return "; " + Quoted(m_moduleName, QuoteSize()) + " will be missing from the " +
               (kind == InputKind::Index ? "search" : "contents") + " of " +
               kSetNames[m_findings.Scope().set];
    }

    void ReportMergedPage(bool wasReported, const JsonPointer& pointer, const Value& page)
    {
        if (!wasReported)
        {
            m_findings.AddAtValue("merged-input", page, pointer,
                                  [&]
                                  {
                                      return "this is an output: the page entry names its module, " +
                                             DescribeValue(page[2], QuoteSize()) +
                                             Consequence(InputKind::Index);
                                  });
        }
    }

    /// Reports the first node that has a module. Returns whether to go on.
    bool ReportTaggedNode(const Value& node, const JsonPointer& pointer, bool isSound)
    {
        if (FindMember(node, "module") != nullptr)
        {
            m_findings.AddAtValue("merged-input", node, pointer,
                                  [&]
                                  {
                                      return "this is an output: the node names its module, " +
                                             DescribeValue(*FindMember(node, "module"), QuoteSize()) +
                                             (isSound ? "; its links will lead to that module"
                                                      : Consequence(InputKind::Toc));
                                  });
            return false;
        }
        const Value* const children = FindMember(node, "children");
        const JsonPointer list(pointer, "children");
        for (rapidjson::SizeType i = 0; children != nullptr && children->IsArray() && i < children->Size();
             ++i)
        {
            if (!ReportTaggedNode((*children)[i], {list, i}, isSound))
            {
                return false;
            }
        }
        return true;
    }

    FileFindings m_findings;
    const std::string& m_moduleName;
    const Value& m_document;
};

std::set<std::string> NamesOf(const Value& object)
{
    std::set<std::string> names;
    for (const auto& member : object.GetObject())
    {
        names.emplace(BytesOf(member.name));
    }
    return names;
}

/// Checks what was read, and returns what it holds.
InputFacts CheckInputText(InputKind kind, const InputText& text, const FileScope& scope,
                          const std::string& moduleName, const TextChecks& checks, Report& report)
{
    DocumentPool pool;
    rapidjson::Document document(&pool.allocator);
    const rapidjson::ParseResult failure = ParseJson(text.bytes.get(), document);
    const std::string_view seen = text.bytes.get();

    InputFacts facts;
    facts.state = InputFacts::State::Refused;
    InputCheck check(scope, moduleName, document);
    check.CheckBytes(seen, text.bytesRead);
    if (failure.IsError())
    {
        check.ReportRefusal(kind, seen, text.bytesRead, failure);
    }
    else if (kind == InputKind::Index ? check.CheckIndex() : check.CheckToc())
    {
        facts.state = InputFacts::State::Sound;
    }
    if (facts.IsSound() && kind == InputKind::Index)
    {
        facts.commonWords = NamesOf(*FindMember(document, "common"));
        CheckIndexTexts(document, checks, check.Findings());
    }
    else if (facts.IsSound())
    {
        facts.rootLink = CStringOf(*FindMember(document, "link"));
        facts.rootTitle = CStringOf(*FindMember(document, "title"));
        CheckTocTexts(document, checks, check.Findings());
    }
    check.Findings().HandTo(report, text.bytes.get(), document);
    return facts;
}

} // namespace

InputFacts CheckInput(InputKind kind, const FileScope& scope, const std::string& moduleName,
                      const TextChecks& checks, Report& report)
{
    const InputText text = ReadInputFile(scope.path.c_str());
    if (text.outcome != InputText::Outcome::Read)
    {
        InputFacts facts;
        facts.state = InputFacts::State::Unreadable;
        return facts;
    }
    return CheckInputText(kind, text, scope, moduleName, checks, report);
}

std::vector<ValuePlace> LocateRoot(const std::string& path)
{
    const InputText text = ReadInputFile(path.c_str());
    rapidjson::Document document;
    if (text.outcome != InputText::Outcome::Read || ParseJson(text.bytes.get(), document).IsError())
    {
        return {};
    }
    const Value* const link = FindMember(document, "link");
    const Value* const title = FindMember(document, "title");
    if (link == nullptr || title == nullptr)
    {
        return {};
    }
    return LocateValues(text.bytes.get(), document, {link, title});
}
