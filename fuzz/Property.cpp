#include "fuzz/Property.h"

#include "Tools/DocTools/VantorPagemeld/Read/JsonDocument.h"
#include "Tools/DocTools/VantorPagemeld/Read/JsonReader.h"

#include <algorithm>
#include <cmath>
#include <cstdio>
#include <cstdlib>
#include <string_view>

namespace
{

bool IsSameNumber(const rapidjson::Value& a, const rapidjson::Value& b)
{
    if (a.IsDouble() || b.IsDouble())
    {
        const double left = a.GetDouble();
        const double right = b.GetDouble();
        return a.IsDouble() && b.IsDouble() && left == right && std::signbit(left) == std::signbit(right);
    }
    return a == b;
}

bool IsSameMember(const rapidjson::Value::Member& a, const rapidjson::Value::Member& b)
{
    return BytesOf(a.name) == BytesOf(b.name) && IsSameValue(a.value, b.value);
}

} // namespace

void Require(bool holds, const char* property)
{
    if (!holds)
    {
        std::fprintf(stderr, "broken property: %s\n", property);
        std::abort();
    }
}

bool IsSameValue(const rapidjson::Value& a, const rapidjson::Value& b)
{
    if (a.GetType() != b.GetType())
    {
        return false;
    }
    switch (a.GetType())
    {
    case rapidjson::kObjectType:
        return std::equal(a.MemberBegin(), a.MemberEnd(), b.MemberBegin(), b.MemberEnd(), IsSameMember);
    case rapidjson::kArrayType:
        return std::equal(a.Begin(), a.End(), b.Begin(), b.End(), IsSameValue);
    case rapidjson::kStringType:
        return BytesOf(a) == BytesOf(b);
    case rapidjson::kNumberType:
        return IsSameNumber(a, b);
    default:
        return true;
    }
}

void RequireReadsBack(const rapidjson::Value& value, const char* written)
{
    rapidjson::Document again;
    Require(!ParseJson(written, again).IsError(), "a written text is accepted");
    again.Parse<rapidjson::kParseFullPrecisionFlag>(written);
    Require(IsSameValue(value, again), "a written text reads back equal");
}

std::vector<std::string> SplitInput(const std::uint8_t* data, std::size_t size)
{
    std::vector<std::string> texts(1);
    for (const char c : std::string_view(reinterpret_cast<const char*>(data), size))
    {
        if (c == '\0')
        {
            texts.emplace_back();
        }
        else
        {
            texts.back() += c;
        }
    }
    return texts;
}
