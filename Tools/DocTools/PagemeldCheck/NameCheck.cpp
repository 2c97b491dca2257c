#include "Tools/DocTools/PagemeldCheck/NameCheck.h"

#include "Tools/DocTools/PagemeldCheck/ByteSet.h"
#include "Tools/DocTools/VantorPagemeld/Read/JsonDocument.h"

#include <algorithm>

namespace
{

using rapidjson::Value;

constexpr std::string_view kPrototype = "__proto__";

/// Whether pages can look the term up, which split queries into words in lower case. Bytes above 0x7F pass as
/// letters.
bool IsWord(std::string_view term)
{
    static constexpr ByteSet kInWords = ByteSet("_").With('a', 'z').With('0', '9').With(0x80, 0xFF);
    return !term.empty() && kInWords.HasAllOf(term);
}

void ReportPrototype(const std::string& kind, const Value& value, const JsonPointer& parent,
                     FileFindings& findings)
{
    findings.AddAtValue(
        Rule::SpecialTerm, value, {parent, kPrototype},
        [&] { return kind + " \"__proto__\" sets a prototype in the scripts: readers do not find it"; });
}

void CheckCommonWords(const Value& words, bool count, FileFindings& findings)
{
    const JsonPointer root;
    const JsonPointer common(root, "common");
    std::size_t prototypes = 0;
    for (const auto& member : words.GetObject())
    {
        if (BytesOf(member.name) != kPrototype)
        {
            continue;
        }
        if (++prototypes == 2 && count)
        {
            findings.AddAtValue(
                Rule::ScriptBroken, member.value, {common, kPrototype},
                [] { return "common word \"__proto__\" twice breaks global_index.js in every module"; });
        }
        else
        {
            ReportPrototype("common word", member.value, common, findings);
        }
    }
}

void CheckTerms(const Value& terms, FileFindings& findings)
{
    const JsonPointer root;
    const JsonPointer searchIndex(root, "searchIndex");
    const Value::Member* firstUnfound = nullptr;
    std::size_t unfound = 0;
    for (const auto& member : terms.GetObject())
    {
        const std::string_view term = BytesOf(member.name);
        if (!IsWord(term))
        {
            firstUnfound = unfound++ == 0 ? &member : firstUnfound;
        }
        else if (term == kPrototype)
        {
            ReportPrototype("term", member.value, searchIndex, findings);
        }
    }
    if (unfound > 0)
    {
        const std::string_view term = BytesOf(firstUnfound->name);
        findings.AddAtValue(
            Rule::UnfoundTerm, firstUnfound->value, {searchIndex, term},
            [&]
            {
                return "terms that readers can't find by the whole word, since words are looked up as "
                       "letters, digits and _ in lower case (the page script ignores case): " +
                       std::to_string(unfound) + ", first " + findings.Quote(term);
            });
    }
}

/// Reports a member that the object has twice.
void ReportSecond(const Value& object, const char* name, FileFindings& findings)
{
    const JsonPointer root;
    const auto isNamed = [&](const auto& member) { return BytesOf(member.name) == name; };
    const auto end = object.MemberEnd();
    const auto first = std::find_if(object.MemberBegin(), end, isNamed);
    const auto second = first == end ? end : std::find_if(first + 1, end, isNamed);
    if (second != end)
    {
        findings.AddAtValue(Rule::DoubledMember, second->value, {root, name},
                            [&]
                            { return "\"" + std::string(name) + "\" is there twice: this one is ignored"; });
    }
}

} // namespace

void CheckTopMembers(const Value& document, FileFindings& findings)
{
    if (!document.IsObject())
    {
        return;
    }
    const std::vector<const char*> names = findings.Scope().input == Input::Index
                                               ? std::vector{"pages", "info", "common", "searchIndex"}
                                               : std::vector{"link", "title", "children"};
    for (const char* name : names)
    {
        ReportSecond(document, name, findings);
    }
}

void CheckWords(const Value& index, bool commonWordsCount, FileFindings& findings)
{
    CheckCommonWords(*FindMember(index, "common"), commonWordsCount, findings);
    CheckTerms(*FindMember(index, "searchIndex"), findings);
}
