#pragma once

#include <rapidjson/document.h>

#include <array>
#include <cstddef>
#include <cstring>
#include <string_view>
#include <utility>

// The memory of a JSON document, copies of its values, and access to them that never triggers an assertion of
// the JSON library, whatever the value is.
//
// References into an array or object become invalid when that array or object grows. The text of a string
// lives as long as the value that holds it, since short texts lie inside the value itself.

/// The memory of a document: first a small block, then the large blocks that the library takes.
///
/// A small module fits into the small block. Without it, each of perhaps hundreds of modules would begin with
/// a large one.
struct DocumentPool
{
    alignas(std::max_align_t) std::array<char, std::size_t{8} << 10> start;
    rapidjson::Document::AllocatorType allocator{start.data(), start.size()};
};

/// Returns all bytes of a JSON string, NUL included.
inline std::string_view BytesOf(const rapidjson::Value& string)
{
    return {string.GetString(), string.GetStringLength()};
}

/// Returns the first member of that name, or null when object has none or is not an object.
inline const rapidjson::Value* FindMember(const rapidjson::Value& object, const char* name)
{
    if (!object.IsObject())
    {
        return nullptr;
    }
    // The library's own search makes a value of the name first, which takes longer than the search.
    const std::string_view wanted = name;
    for (const auto& member : object.GetObject())
    {
        if (BytesOf(member.name) == wanted)
        {
            return &member.value;
        }
    }
    return nullptr;
}

inline rapidjson::Value* FindMember(rapidjson::Value& object, const char* name)
{
    return const_cast<rapidjson::Value*>(FindMember(static_cast<const rapidjson::Value&>(object), name));
}

/// What makes two entries of a table of contents one: equal links and equal titles, as NUL-terminated texts.
struct EntryKey
{
    const char* link;
    const char* title;

    friend bool operator==(const EntryKey& a, const EntryKey& b)
    {
        return std::strcmp(a.link, b.link) == 0 && std::strcmp(a.title, b.title) == 0;
    }
};

/// Returns a JSON string as NUL-terminated text: it ends at the first NUL.
inline const char* CStringOf(const rapidjson::Value& string)
{
    return string.GetString();
}

/// A document that is built of parse events, and copies every string. The library's own copy of a value
/// shares constant strings with the original.
class CopyBuilder : public rapidjson::Document
{
public:
    explicit CopyBuilder(AllocatorType& allocator) : GenericDocument(&allocator) {}

    bool String(const char* text, rapidjson::SizeType length, bool /*copy*/)
    {
        return GenericDocument::String(text, length, true);
    }

    bool Key(const char* text, rapidjson::SizeType length, bool copy) { return String(text, length, copy); }
};

/// Returns a copy of the value that shares nothing with it, made with the allocator.
inline rapidjson::Value DeepCopy(const rapidjson::Value& value, rapidjson::Document::AllocatorType& allocator)
{
    CopyBuilder builder(allocator);
    const auto replay = [&](rapidjson::Document& /*builder*/) { return value.Accept(builder); };
    builder.Populate(replay);
    return std::move(static_cast<rapidjson::Value&>(builder));
}
