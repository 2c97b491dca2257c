#include "Tools/DocTools/PagemeldCheck/InputCheck.h"

#include "Tools/DocTools/PagemeldCheck/Explain/FaultText.h"
#include "Tools/DocTools/PagemeldCheck/Explain/ParseFailure.h"
#include "Tools/DocTools/PagemeldCheck/Explain/ShownText.h"
#include "Tools/DocTools/PagemeldCheck/NameCheck.h"
#include "Tools/DocTools/PagemeldCheck/Report/FileFindings.h"
#include "Tools/DocTools/PagemeldCheck/TextCheck.h"
#include "Tools/DocTools/VantorPagemeld/Check/IndexStructure.h"
#include "Tools/DocTools/VantorPagemeld/Check/TocStructure.h"
#include "Tools/DocTools/VantorPagemeld/Read/InputFile.h"
#include "Tools/DocTools/VantorPagemeld/Read/JsonDocument.h"
#include "Tools/DocTools/VantorPagemeld/Read/JsonReader.h"
#include "Tools/DocTools/VantorPagemeld/System/FileStatus.h"

#include <cerrno>
#include <utility>

namespace
{

using rapidjson::Value;

constexpr std::size_t kNone = std::string_view::npos;

/// Whether an entry of pages has the form that only the combined index has: a third element, the module.
bool IsMergedPage(const Value& entry)
{
    return entry.IsArray() && entry.Size() == 3 && entry[2].IsInt();
}

std::set<std::string> NamesOf(const Value& object)
{
    std::set<std::string> names;
    for (const auto& member : object.GetObject())
    {
        names.emplace(BytesOf(member.name));
    }
    return names;
}

/// One file while it is checked.
class InputCheck
{
public:
    InputCheck(const FileScope& scope, const char* text, const Value& document)
        : m_scope(scope), m_findings(scope), m_text(text), m_document(document)
    {
    }

    FileFindings& Findings() { return m_findings; }

    /// Looks for what the parser accepts and readers don't get.
    void CheckBytes(std::string_view seen, std::size_t size)
    {
        const std::size_t invalid = FindInvalidUtf8(seen);
        if (invalid != kNone)
        {
            m_findings.Add(Rule::InvalidUtf8,
                           "byte " + Visible(seen.substr(invalid, 1)) +
                               " is not UTF-8: readers see a replacement character",
                           invalid);
        }
        const std::size_t half = FindLoneHalf(seen);
        if (half != kNone)
        {
            m_findings.Add(Rule::InvalidUtf8,
                           "half of a surrogate pair: readers see replacement characters, and other programs "
                           "may refuse the JSON outputs; write both halves or neither",
                           half);
        }
        if (seen.size() + 1 < size)
        {
            m_findings.Add(Rule::TextAfterNul,
                           "a NUL byte ends the text; bytes after it that are not seen: " +
                               std::to_string(size - seen.size() - 1),
                           seen.size());
        }
    }

    void ReportRefusal(std::string_view seen, std::size_t size, const rapidjson::ParseResult& failure)
    {
        m_findings.Add(Rule::NotJson, DescribeParseFailure(seen, size, failure) + "; " + m_scope.Loss(),
                       failure.Offset());
    }

    /// Returns whether the tool takes the document.
    bool CheckStructure()
    {
        bool isSound = true;
        CheckTopMembers(m_document, m_findings);
        const auto onFault = [&](const FoundFault& found)
        {
            isSound = false;
            ReportFault(found);
            return true;
        };
        if (m_scope.input == Input::Index)
        {
            CheckIndexStructure(m_document, onFault);
            return isSound;
        }
        CheckTocStructure(m_document, onFault);
        (void)ReportTaggedNode(m_document, JsonPointer(), isSound);
        return isSound;
    }

    /// Looks at the texts of a sound document. Returns what it holds.
    InputFacts CheckTexts(EarlierModules& earlier)
    {
        InputFacts facts;
        facts.state = InputFacts::State::Sound;
        if (m_scope.input == Input::Index)
        {
            facts.commonWords = NamesOf(*FindMember(m_document, "common"));
            CheckIndexTexts(m_document, m_findings);
            CheckWords(m_document, !earlier.hasCommonWords, m_findings);
            earlier.hasCommonWords |= !facts.commonWords.empty();
            return facts;
        }
        const Value& link = *FindMember(m_document, "link");
        const Value& title = *FindMember(m_document, "title");
        facts.rootLink = CStringOf(link);
        facts.rootTitle = CStringOf(title);
        if (!earlier.firstContents || !(earlier.firstContents->Root() == facts.Root()))
        {
            facts.rootPlaces = LocateValues(m_text, m_document, {&link, &title});
        }
        earlier.firstContents = earlier.firstContents.value_or(facts);
        CheckTocTexts(m_document, m_findings);
        earlier.contents.Merge(m_document, m_findings);
        return facts;
    }

private:
    void ReportFault(const FoundFault& found)
    {
        const bool isMerged = found.fault == StructureFault::PageNotPair && IsMergedPage(found.place);
        if (isMerged && !std::exchange(m_wasMergedReported, true))
        {
            ReportMerged("page entry", found.place, found.pointer, found.place[2], "; " + m_scope.Loss());
        }
        else if (!isMerged)
        {
            m_findings.AddAtValue(Rule::Structure, found.place, found.pointer,
                                  [&] {
                                      return DescribeFault(found, m_document, m_scope.options.quoteSize) +
                                             "; " + m_scope.Loss();
                                  });
        }
    }

    void ReportMerged(const std::string& kind, const Value& value, const JsonPointer& pointer,
                      const Value& module, const std::string& consequence)
    {
        m_findings.AddAtValue(Rule::MergedInput, value, pointer,
                              [&]
                              {
                                  return "this is an output: the " + kind + " names its module, " +
                                         DescribeValue(module, m_scope.options.quoteSize) + consequence;
                              });
    }

    /// Reports the first node that has a module. Returns whether to go on.
    bool ReportTaggedNode(const Value& node, const JsonPointer& pointer, bool isSound)
    {
        if (const Value* module = FindMember(node, "module"))
        {
            ReportMerged("node", node, pointer, *module,
                         isSound ? "; its links will lead to that module" : "; " + m_scope.Loss());
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

    const FileScope& m_scope;
    FileFindings m_findings;
    const char* m_text;
    const Value& m_document;
    bool m_wasMergedReported = false;
};

/// Whether something is at path, or may be: a directory may hide what is in it.
bool IsThere(const std::string& path)
{
    const FileStatus status = FileStatus::OfEntry(path);
    return status.Exists() || status.Error() == EACCES;
}

/// Checks what was read, and returns what it holds.
InputFacts CheckInputText(const InputText& text, const FileScope& scope, EarlierModules& earlier,
                          Report& report)
{
    DocumentPool pool;
    rapidjson::Document document(&pool.allocator);
    const rapidjson::ParseResult failure = ParseJson(text.bytes.get(), document);
    const std::string_view seen = text.bytes.get();

    InputFacts facts;
    facts.state = InputFacts::State::Refused;
    InputCheck check(scope, text.bytes.get(), document);
    check.CheckBytes(seen, text.bytesRead);
    if (failure.IsError())
    {
        check.ReportRefusal(seen, text.bytesRead, failure);
    }
    else if (check.CheckStructure())
    {
        facts = check.CheckTexts(earlier);
    }
    check.Findings().HandTo(report, text.bytes.get(), document);
    return facts;
}

} // namespace

InputFacts CheckInput(const FileScope& scope, EarlierModules& earlier, Report& report)
{
    const InputText text = ReadInputFile(scope.file.path.c_str());
    if (text.outcome == InputText::Outcome::Read)
    {
        return CheckInputText(text, scope, earlier, report);
    }
    InputFacts facts;
    facts.state = IsThere(scope.file.path) ? InputFacts::State::Unreadable : InputFacts::State::Missing;
    return facts;
}
