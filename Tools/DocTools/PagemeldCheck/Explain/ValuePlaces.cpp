#include "Tools/DocTools/PagemeldCheck/Explain/ValuePlaces.h"

#include <rapidjson/reader.h>

#include <algorithm>
#include <cstring>
#include <iterator>
#include <string_view>
#include <unordered_map>

// A document does not keep the places of its values in the text. A pointer such as "/a/0" can't tell them
// either, since an object may hold a name twice. So values are counted in document order: one walk over the
// document gives the number of each value asked for, and a second parse of the text stops at those numbers.
// Neither recurses: documents may be nested deeper than a small stack holds.

namespace
{

using rapidjson::SizeType;
using rapidjson::Value;

/// A value asked for, by its number in document order.
struct SoughtValue
{
    std::size_t number;
    ValuePlace* place;
};

SizeType CountChildren(const Value& value)
{
    return value.IsArray() ? value.Size() : value.IsObject() ? value.MemberCount() : 0;
}

/// An array or object that a walk over a document has come to.
struct OpenValue
{
    const Value* value;
    SizeType nextChild;
};

/// Returns the next value in document order, or null after the last.
const Value* TakeNext(std::vector<OpenValue>& open)
{
    while (!open.empty() && open.back().nextChild == CountChildren(*open.back().value))
    {
        open.pop_back();
    }
    if (open.empty())
    {
        return nullptr;
    }
    const Value& parent = *open.back().value;
    const SizeType i = open.back().nextChild++;
    return parent.IsArray() ? &parent[i] : &(parent.MemberBegin() + i)->value;
}

using PlaceTable = std::unordered_map<const Value*, ValuePlace>;

/// Returns the values of the table in document order.
std::vector<SoughtValue> NumberValues(const Value& document, PlaceTable& places)
{
    std::vector<SoughtValue> sought;
    std::vector<OpenValue> open;
    const Value* value = &document;
    for (std::size_t number = 0; value != nullptr && sought.size() < places.size(); ++number)
    {
        const auto found = places.find(value);
        if (found != places.end())
        {
            sought.push_back({number, &found->second});
        }
        if (CountChildren(*value) > 0)
        {
            open.push_back({value, 0});
        }
        value = TakeNext(open);
    }
    return sought;
}

/// A string stream that tells a handler where the current token ends. The library's reader copies a plain
/// StringStream while it reads a token, and the handler would see an outdated position.
struct TrackedStream : rapidjson::StringStream
{
    explicit TrackedStream(const char* text) : rapidjson::StringStream(text) {}
};

/// Takes the events of a parse, notes where the sought values begin, and ends the parse after the last.
///
/// The event of an opening bracket comes before it is read, any other event after its token. Between a
/// token and the next value there are only white space, commas, colons and closing brackets.
class PlaceFinder : public rapidjson::BaseReaderHandler<rapidjson::UTF8<>, PlaceFinder>
{
public:
    PlaceFinder(const char* text, const TrackedStream& stream, const std::vector<SoughtValue>& sought)
        : m_text(text), m_stream(stream), m_sought(sought)
    {
    }

    /// Takes every event that begins a value.
    bool Default()
    {
        const std::size_t start = m_tokenEnd + std::strspn(m_text + m_tokenEnd, " \t\r\n,:]}");
        m_tokenEnd = std::max(m_stream.Tell(), start + 1);
        if (m_sought[m_foundCount].number == m_number++)
        {
            m_sought[m_foundCount++].place->offset = start;
        }
        return m_foundCount < m_sought.size();
    }

    bool Key(const char*, SizeType, bool)
    {
        m_tokenEnd = m_stream.Tell();
        return true;
    }

    bool EndObject(SizeType) { return true; }
    bool EndArray(SizeType) { return true; }

private:
    const char* m_text;
    const TrackedStream& m_stream;
    const std::vector<SoughtValue>& m_sought;
    std::size_t m_foundCount = 0;
    std::size_t m_number = 0; ///< of the next value
    std::size_t m_tokenEnd = 0;
};

void FindOffsets(const char* text, const std::vector<SoughtValue>& sought)
{
    // Numbers are read as strings: this is the text before ParseJson changed those that the library can't
    // convert.
    constexpr unsigned kFlags = rapidjson::kParseIterativeFlag | rapidjson::kParseNumbersAsStringsFlag;
    TrackedStream stream(text);
    PlaceFinder finder(text, stream, sought);
    rapidjson::Reader().Parse<kFlags>(stream, finder);
}

/// Moves the place on to a later byte of the text.
void MoveTo(ValuePlace& place, const char* text, std::size_t offset)
{
    const std::string_view reached(text, offset);
    std::size_t lineEnd = reached.find('\n', place.offset);
    while (lineEnd != std::string_view::npos)
    {
        place = {lineEnd + 1, place.line + 1, 1};
        lineEnd = reached.find('\n', place.offset);
    }
    place = {offset, place.line, place.column + offset - place.offset};
}

} // namespace

std::vector<ValuePlace> LocateValues(const char* text, const Value& document,
                                     const std::vector<const Value*>& values)
{
    PlaceTable placeOf;
    for (const Value* value : values)
    {
        placeOf.try_emplace(value);
    }
    const std::vector<SoughtValue> sought = NumberValues(document, placeOf);
    if (!sought.empty())
    {
        FindOffsets(text, sought);
    }
    ValuePlace reached;
    for (const SoughtValue& value : sought)
    {
        MoveTo(reached, text, value.place->offset);
        *value.place = reached;
    }

    std::vector<ValuePlace> places;
    places.reserve(values.size());
    std::transform(values.begin(), values.end(), std::back_inserter(places),
                   [&](const Value* value) { return placeOf.at(value); });
    return places;
}

ValuePlace PlaceOfOffset(const char* text, std::size_t offset)
{
    ValuePlace place;
    MoveTo(place, text, offset);
    return place;
}
