#include "Tools/DocTools/VantorPagemeld/Read/JsonReader.h"

#include "Tools/DocTools/VantorPagemeld/Read/NumberGuard.h"

#include <rapidjson/reader.h>

#include <cmath>

// The library parses into a document without any limit on nesting: a recursion over what it accepted, its own
// included, could overflow the stack. So its reader hands the events to a builder, a document that counts
// levels and refuses what no writer could write. That costs two comparisons for an array or object and one
// for a string or double. A text that is refused is parsed twice, since only a document's own parse sets its
// error.

namespace
{

/// A document that is built of parse events, and ends the parse at the first one that breaks a limit.
class LimitedBuilder : public rapidjson::Document
{
public:
    explicit LimitedBuilder(AllocatorType& allocator) : GenericDocument(&allocator) {}

    /// Some numbers above the largest double arrive as an infinity, which no writer could write.
    bool Double(double value) { return std::isfinite(value) && GenericDocument::Double(value); }

    bool String(const char* text, rapidjson::SizeType length, bool copy)
    {
        return length <= kMaxStringBytes && GenericDocument::String(text, length, copy);
    }

    bool Key(const char* text, rapidjson::SizeType length, bool copy) { return String(text, length, copy); }
    bool StartObject() { return Enter() && GenericDocument::StartObject(); }
    bool StartArray() { return Enter() && GenericDocument::StartArray(); }

    bool EndObject(rapidjson::SizeType memberCount)
    {
        --m_depth;
        return GenericDocument::EndObject(memberCount);
    }

    bool EndArray(rapidjson::SizeType elementCount)
    {
        --m_depth;
        return GenericDocument::EndArray(elementCount);
    }

private:
    bool Enter() { return ++m_depth <= kMaxNestingDepth; }

    std::uint32_t m_depth = 0;
};

/// A stream that holds nothing and is at a given offset: parsing it fails there. This is the
/// only way to give a document an error that one of our own limits found.
struct FailedStream : rapidjson::StringStream
{
    explicit FailedStream(std::size_t failure) : GenericStringStream(""), offset(failure) {}

    [[nodiscard]] std::size_t Tell() const { return offset; }

    std::size_t offset;
};

/// Leaves the document null, with the failure as its parse error.
void RecordFailure(rapidjson::Document& document, const char* text, const rapidjson::ParseResult& failure)
{
    if (failure.Code() == rapidjson::kParseErrorTermination)
    {
        FailedStream stream(failure.Offset());
        document.ParseStream(stream);
        return;
    }
    document.Parse(text); // stops at the same place for the same reason
}

} // namespace

rapidjson::ParseResult ParseJson(const char* text, rapidjson::Document& document)
{
    const std::optional<std::string> guardedText = GuardNumbers(text);
    const char* const readableText = guardedText ? guardedText->c_str() : text;
    rapidjson::Reader reader;
    document.Parse("null"); // a failed parse would keep an old value, and a good one an old error
    LimitedBuilder builder(document.GetAllocator());
    const auto read = [&](rapidjson::Document& /*builder*/)
    {
        rapidjson::StringStream stream(readableText);
        return !reader.Parse(stream, builder).IsError();
    };
    builder.Populate(read);
    if (!reader.HasParseError())
    {
        static_cast<rapidjson::Value&>(document) = static_cast<rapidjson::Value&>(builder); // moves
        return {};
    }
    const rapidjson::ParseResult failure(reader.GetParseErrorCode(), reader.GetErrorOffset());
    RecordFailure(document, readableText, failure);
    return failure;
}
