#include "Tools/DocTools/PagemeldCheck/Explain/FaultText.h"

#include "Tools/DocTools/PagemeldCheck/Explain/ShownText.h"
#include "Tools/DocTools/VantorPagemeld/Read/JsonDocument.h"
#include "Tools/DocTools/VantorPagemeld/Render/TextBuffer.h"

namespace
{

using rapidjson::Value;

/// Returns "but there are 3 pages, numbered from 0" or "but there is 1 page, ..." for the entries of an array
/// of the document, which must be one: otherwise no number is out of its bounds.
std::string CountEntries(const Value& document, const char* member, const std::string& noun)
{
    const rapidjson::SizeType count = FindMember(document, member)->Size();
    return (count == 1 ? "but there is " : "but there are ") + Counted(count, noun) + ", numbered from 0";
}

/// Returns the value whose type is wrong in a pair of strings.
const Value& FirstNonString(const Value& pair)
{
    return pair[0].IsString() ? pair[1] : pair[0];
}

} // namespace

std::string DescribeValue(const Value& value, std::size_t quoteSize)
{
    if (value.IsString())
    {
        return Quoted(BytesOf(value), quoteSize);
    }
    if (value.IsArray())
    {
        return "an array of " + std::to_string(value.Size());
    }
    if (value.IsObject())
    {
        return "an object of " + std::to_string(value.MemberCount());
    }
    TextBuffer text;
    AppendCompactJson(text, value);
    return text.GetString();
}

std::string DescribeFault(const FoundFault& found, const Value& document, std::size_t quoteSize)
{
    const Value& value = found.place;
    const auto show = [&](const Value& part) { return DescribeValue(part, quoteSize); };
    const auto member = [&](const std::string& name, const std::string& kind)
    {
        return found.value == nullptr ? "\"" + name + "\" is missing; it must be " + kind
                                      : "\"" + name + "\" is " + show(value) + ", not " + kind;
    };
    switch (found.fault)
    {
    case StructureFault::PagesNotArray:
        return member("pages", "an array");
    case StructureFault::InfoNotArray:
        return member("info", "an array");
    case StructureFault::CommonNotObject:
        return member("common", "an object");
    case StructureFault::SearchIndexNotObject:
        return member("searchIndex", "an object");
    case StructureFault::PageNotPair:
        return "page entry is " + show(value) + ", not [path, title]";
    case StructureFault::PageNotStrings:
        return "page path or title is " + show(FirstNonString(value)) + ", not a string";
    case StructureFault::InfoNotPair:
        return "info entry is " + show(value) + ", not [text, page number]";
    case StructureFault::InfoTextNotString:
        return "text is " + show(value[0]) + ", not a string";
    case StructureFault::InfoPageNotInt:
        return "page number is " + show(value[1]) + ", not a 32-bit integer";
    case StructureFault::InfoPageOutOfBounds:
        return "page number " + show(value[1]) + ", " + CountEntries(document, "pages", "page");
    case StructureFault::CommonValueNotOne:
        return "common word has the value " + show(value) + ", not 1";
    case StructureFault::TermNotArray:
        return "term has " + show(value) + ", not an array of info numbers";
    case StructureFault::PostingNotInt:
        return "info number is " + show(value) + ", not a 32-bit integer";
    case StructureFault::PostingOutOfBounds:
        return "info number " + show(value) + ", " + CountEntries(document, "info", "info");
    case StructureFault::NodeNotAnObject:
        return "node is " + show(value) + ", not an object";
    case StructureFault::TitleNotString:
        return member("title", "a string");
    case StructureFault::LinkNotString:
        return member("link", "a string");
    case StructureFault::ChildrenNotList:
        return member("children", "an array or null");
    case StructureFault::CommonKeyNotString: // these two can't be in parsed text
    case StructureFault::TermNotString:
    case StructureFault::NotAnObject:
    case StructureFault::Count:
        break;
    }
    return "the document is " + show(value) + ", not an object";
}
