#include "Tools/DocTools/VantorPagemeld/RapidJsonIoUtil.h"
#include "Tools/DocTools/VantorPagemeld/Read/JsonReader.h"
#include "fuzz/Property.h"

#include <algorithm>
#include <cmath>

// The reader accepts exactly what the library accepts within our limits; what is written and read again is
// equal.

namespace
{

bool HasFiniteNumbersOnly(const rapidjson::Value& value)
{
    if (value.IsObject())
    {
        return std::all_of(value.MemberBegin(), value.MemberEnd(),
                           [](const auto& member) { return HasFiniteNumbersOnly(member.value); });
    }
    if (value.IsArray())
    {
        return std::all_of(value.Begin(), value.End(), HasFiniteNumbersOnly);
    }
    return !value.IsDouble() || std::isfinite(value.GetDouble());
}

void RequireSameFailure(const rapidjson::ParseResult& result, const rapidjson::Document& document,
                        const rapidjson::Document& plain)
{
    Require(document.IsNull() && document.HasParseError(), "a refused text leaves null and an error");
    Require(document.GetErrorOffset() == result.Offset(), "document and result agree on the place");
    if (result.Code() == rapidjson::kParseErrorTermination)
    {
        Require(
            plain.HasParseError() ? result.Offset() < plain.GetErrorOffset() : !HasFiniteNumbersOnly(plain),
            "what is refused beyond the library's rules is an infinite number before any error of theirs");
        return;
    }
    Require(document.GetParseError() == plain.GetParseError() && result.Code() == plain.GetParseError() &&
                result.Offset() == plain.GetErrorOffset(),
            "any other refusal is the library's");
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size)
{
    const std::string text = SplitInput(data, size).front();
    rapidjson::Document plain;
    plain.Parse(text.c_str());
    rapidjson::Document document;
    document.SetString("old");
    const rapidjson::ParseResult result = ParseJson(text.c_str(), document);
    if (result.IsError())
    {
        RequireSameFailure(result, document, plain);
        return 0;
    }
    Require(!plain.HasParseError() && IsSameValue(document, plain),
            "an accepted text is what the library reads");
    RequireReadsBack(document, RapidJsonIoUtil::OutputJsonValueToString(document).c_str());
    RequireReadsBack(document, RenderPrettyJson(document).GetString());
    return 0;
}
