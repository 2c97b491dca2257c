#include "Tools/DocTools/VantorPagemeld/Json/JsonReader.h"

#include "Tools/DocTools/VantorPagemeld/Json/NumberLimit.h"

#include <rapidjson/reader.h>

#include <cmath>

namespace
{

/// Hands parse events on to a document, and ends the parse at the first one that breaks a limit.
class LimitedDocumentBuilder
{
public:
    explicit LimitedDocumentBuilder(rapidjson::Document& document) : m_document(document) {}

    bool Null() { return m_document.Null(); }
    bool Bool(bool value) { return m_document.Bool(value); }
    bool Int(int value) { return m_document.Int(value); }
    bool Uint(unsigned value) { return m_document.Uint(value); }
    bool Int64(std::int64_t value) { return m_document.Int64(value); }
    bool Uint64(std::uint64_t value) { return m_document.Uint64(value); }

    /// Some numbers above the largest double reach here as an infinity, which no writer could write.
    bool Double(double value) { return std::isfinite(value) && m_document.Double(value); }

    bool RawNumber(const char* text, rapidjson::SizeType length, bool copy)
    {
        return m_document.RawNumber(text, length, copy);
    }

    bool String(const char* text, rapidjson::SizeType length, bool copy)
    {
        return length <= kMaxStringBytes && m_document.String(text, length, copy);
    }

    bool Key(const char* text, rapidjson::SizeType length, bool copy) { return String(text, length, copy); }
    bool StartObject() { return Enter() && m_document.StartObject(); }
    bool StartArray() { return Enter() && m_document.StartArray(); }

    bool EndObject(rapidjson::SizeType memberCount)
    {
        --m_depth;
        return m_document.EndObject(memberCount);
    }

    bool EndArray(rapidjson::SizeType elementCount)
    {
        --m_depth;
        return m_document.EndArray(elementCount);
    }

private:
    bool Enter() { return ++m_depth <= kMaxNestingDepth; }

    rapidjson::Document& m_document;
    std::uint32_t m_depth = 0;
};

/// A stream that holds nothing and stands at a given offset: parsing it fails there. It is the one way to
/// have a document report an error that another reader met.
struct FailedStream
{
    using Ch = char;

    std::size_t offset;

    [[nodiscard]] char Peek() const { return '\0'; }
    [[nodiscard]] std::size_t Tell() const { return offset; }
    char Take() { return '\0'; }
    char* PutBegin() { return nullptr; }
    void Put(char) {}
    void Flush() {}
    std::size_t PutEnd(char*) { return 0; }
};

} // namespace

rapidjson::ParseResult ParseJson(const char* text, rapidjson::Document& document)
{
    const std::optional<std::string> limitedText = LimitNumbers(text);
    rapidjson::Reader reader;
    const auto readText = [&](rapidjson::Document& target)
    {
        rapidjson::StringStream stream(limitedText ? limitedText->c_str() : text);
        LimitedDocumentBuilder builder(target);
        return !reader.Parse(stream, builder).IsError();
    };

    // A failed parse would leave an old value in place, and a good one an old error.
    document.Parse("null");
    document.Populate(readText);
    if (!reader.HasParseError())
    {
        return {};
    }
    const rapidjson::ParseResult failure(reader.GetParseErrorCode(), reader.GetErrorOffset());
    FailedStream failedStream{failure.Offset()};
    document.ParseStream(failedStream);
    return failure;
}
