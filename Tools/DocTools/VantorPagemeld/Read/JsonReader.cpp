#include "Tools/DocTools/VantorPagemeld/Read/JsonReader.h"

#include "Tools/DocTools/VantorPagemeld/Read/NumberGuard.h"

#include <rapidjson/reader.h>

#include <cmath>

// The library parses into a document without any limit on nesting: a recursion over what it accepted, its own
// included, could overflow the stack. So its reader hands the events to a builder, which counts levels,
// refuses what no writer could write, and passes the rest on to the document. That costs two comparisons for
// an array or object and one for a string or double. A text that is refused is parsed twice, since only a
// document's own parse sets its error.

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

    /// Some numbers above the largest double arrive as an infinity, which no writer could write.
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

/// A stream that holds nothing and is at a given offset: parsing it fails there. This is the
/// only way to give a document an error that one of our own limits found.
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

/// Leaves the document null, with the failure as its parse error.
void RecordFailure(rapidjson::Document& document, const char* text, const rapidjson::ParseResult& failure)
{
    if (failure.Code() == rapidjson::kParseErrorTermination)
    {
        FailedStream stream{failure.Offset()};
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
    const auto read = [&](rapidjson::Document& target)
    {
        rapidjson::StringStream stream(readableText);
        LimitedDocumentBuilder builder(target);
        return !reader.Parse(stream, builder).IsError();
    };

    document.Parse("null"); // a failed parse would keep an old value, and a good one an old error
    document.Populate(read);
    if (!reader.HasParseError())
    {
        return {};
    }
    const rapidjson::ParseResult failure(reader.GetParseErrorCode(), reader.GetErrorOffset());
    RecordFailure(document, readableText, failure);
    return failure;
}
