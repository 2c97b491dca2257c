#include "Tools/DocTools/PagemeldCheck/Explain/FaultText.h"

#include "Tools/DocTools/PagemeldCheck/Explain/ShownText.h"
#include "Tools/DocTools/VantorPagemeld/Read/JsonDocument.h"
#include "Tools/DocTools/VantorPagemeld/Render/TextBuffer.h"

namespace
{

using rapidjson::Value;

/// Returns what should be there and what is: "\"pages\" is missing", "\"pages\" is 7, not an array".
std::string DescribeMember(const char* name, const char* kind, const Value& value, bool isMissing,
                           std::size_t quoteSize)
{
    const std::string member = std::string("\"") + name + "\"";
    return isMissing ? member + " is missing; it must be " + kind
                     : member + " is " + DescribeValue(value, quoteSize) + ", not " + kind;
}

/// Returns "but there are 3 pages" or "but there is 1 page" for the entries of an array of the document,
/// which must be one: otherwise no number is out of its bounds.
std::string CountEntries(const Value& document, const char* member, const std::string& noun)
{
    const rapidjson::SizeType count = FindMember(document, member)->Size();
    return count == 1 ? "but there is 1 " + noun
                      : "but there are " + std::to_string(count) + " " + noun + "s";
}

std::string DescribePair(const char* kind, const char* form, const Value& value, std::size_t quoteSize)
{
    return std::string(kind) + " entry is " + DescribeValue(value, quoteSize) + ", not " + form;
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

std::string DescribeIndexFault(const StructureFault& fault, const JsonPointer& pointer, const Value& value,
                               const Value& document, std::size_t quoteSize)
{
    const bool isMissing = pointer.Text().empty();
    switch (fault.number)
    {
    case 290:
        return DescribeMember("pages", "an array", value, isMissing, quoteSize);
    case 296:
        return DescribeMember("info", "an array", value, isMissing, quoteSize);
    case 302:
        return DescribeMember("common", "an object", value, isMissing, quoteSize);
    case 308:
        return DescribeMember("searchIndex", "an object", value, isMissing, quoteSize);
    case 318:
        return DescribePair("page", "[path, title]", value, quoteSize);
    case 327:
        return "page path or title is " + DescribeValue(FirstNonString(value), quoteSize) + ", not a string";
    case 340:
        return DescribePair("info", "[text, page number]", value, quoteSize);
    case 345:
        return "text is " + DescribeValue(value[0], quoteSize) + ", not a string";
    case 350:
        return "page number is " + DescribeValue(value[1], quoteSize) + ", not a 32-bit integer";
    case 356:
        return "page number " + DescribeValue(value[1], quoteSize) + ", " +
               CountEntries(document, "pages", "page");
    case 371:
        return "common word has the value " + DescribeValue(value, quoteSize) + ", not 1";
    case 387:
        return "term has " + DescribeValue(value, quoteSize) + ", not an array of info numbers";
    case 396:
        return "info number is " + DescribeValue(value, quoteSize) + ", not a 32-bit integer";
    case 401:
        return "info number " + DescribeValue(value, quoteSize) + ", " +
               CountEntries(document, "info", "info");
    default:
        return "the document is " + DescribeValue(value, quoteSize) + ", not an object";
    }
}

std::string DescribeTocFault(const StructureFault& fault, const JsonPointer& pointer, const Value& value,
                             std::size_t quoteSize)
{
    const std::string name = pointer.Text();
    const auto lacks = [&](const char* member)
    {
        const std::string suffix = std::string("/") + member;
        return name.size() < suffix.size() ||
               name.compare(name.size() - suffix.size(), suffix.size(), suffix) != 0;
    };
    switch (fault.number)
    {
    case 372:
        return value.IsObject() || !lacks("title")
                   ? DescribeMember("title", "a string", value, lacks("title"), quoteSize)
                   : "node is " + DescribeValue(value, quoteSize) + ", not an object";
    case 377:
        return DescribeMember("link", "a string", value, lacks("link"), quoteSize);
    default:
        return DescribeMember("children", "an array or null", value, lacks("children"), quoteSize);
    }
}
