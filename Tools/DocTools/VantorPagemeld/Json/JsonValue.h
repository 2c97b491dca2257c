#pragma once

#include <rapidjson/document.h>

#include <string_view>

// Access to JSON values that reaches no assertion of the JSON library, whatever the value is. References into
// an array or object die when that array or object grows; the text of a string lives as long as the value
// that holds it, since short texts lie inside the value itself.

/// Returns the first member of that name, or null when object has none or is not an object.
inline const rapidjson::Value* FindMember(const rapidjson::Value& object, const char* name)
{
    if (!object.IsObject())
    {
        return nullptr;
    }
    const auto member = object.FindMember(name);
    return member == object.MemberEnd() ? nullptr : &member->value;
}

inline rapidjson::Value* FindMember(rapidjson::Value& object, const char* name)
{
    return const_cast<rapidjson::Value*>(FindMember(static_cast<const rapidjson::Value&>(object), name));
}

/// Returns all bytes of a JSON string, NUL included.
inline std::string_view BytesOf(const rapidjson::Value& string)
{
    return {string.GetString(), string.GetStringLength()};
}

/// Returns a JSON string as NUL-terminated text: it ends at the first NUL.
inline const char* CStringOf(const rapidjson::Value& string)
{
    return string.GetString();
}
