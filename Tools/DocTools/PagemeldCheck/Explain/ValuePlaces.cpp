#include "Tools/DocTools/PagemeldCheck/Explain/ValuePlaces.h"

#include <rapidjson/reader.h>

#include <algorithm>
#include <cstring>
#include <iterator>
#include <string_view>
#include <unordered_map>

// A document does not keep where its values stood, and a pointer such as "/a/0" does not say either, since
// an object may hold a name twice. A value's number in document order does. So the document is walked for
// the numbers of the values, and the text is read a second time until all have been found. Neither
// recurses: documents may be nested deeper than a small stack holds.

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

struct OpenValue
{
    const Value* value;
    SizeType nextChild;
};

SizeType CountChildren(const Value& value)
{
    return value.IsArray() ? value.Size() : value.IsObject() ? value.MemberCount() : 0;
}

const Value& ChildAt(const Value& value, SizeType i)
{
    return value.IsArray() ? value[i] : (value.MemberBegin() + i)->value;
}

/// Calls visit with every value of the document, in document order.
template <typename Visit>
void VisitValues(const Value& document, const Visit& visit)
{
    visit(document);
    std::vector<OpenValue> open = {{&document, 0}};
    while (!open.empty())
    {
        OpenValue& top = open.back();
        if (top.nextChild == CountChildren(*top.value))
        {
            open.pop_back();
            continue;
        }
        const Value& child = ChildAt(*top.value, top.nextChild++);
        visit(child);
        if (child.IsArray() || child.IsObject())
        {
            open.push_back({&child, 0});
        }
    }
}

using PlaceTable = std::unordered_map<const Value*, ValuePlace>;

/// Returns the values of the table in document order.
std::vector<SoughtValue> NumberValues(const Value& document, PlaceTable& places)
{
    std::vector<SoughtValue> sought;
    std::size_t number = 0;
    VisitValues(document,
                [&](const Value& value)
                {
                    const auto found = places.find(&value);
                    if (found != places.end())
                    {
                        sought.push_back({number, &found->second});
                    }
                    ++number;
                });
    return sought;
}

/// A string stream of which the library's reader makes no copy while it reads a token, so that a handler can
/// ask it for the end of that token.
struct TrackedStream : rapidjson::StringStream
{
    explicit TrackedStream(const char* text) : rapidjson::StringStream(text) {}
};

/// Takes the events of a parse, notes where the sought values begin, and ends the parse after the last.
///
/// An event comes when its token has been read; for an opening bracket, before. Between the end of one token
/// and the next value stand only white space, commas, colons and closing brackets.
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
    // Numbers as strings, because the library's conversion can't take all that ParseJson accepts.
    constexpr unsigned kFlags = rapidjson::kParseIterativeFlag | rapidjson::kParseNumbersAsStringsFlag;
    TrackedStream stream(text);
    PlaceFinder finder(text, stream, sought);
    rapidjson::Reader().Parse<kFlags>(stream, finder);
}

/// Moves the place on to a later byte of the text.
void MoveTo(ValuePlace& place, const char* text, std::size_t offset)
{
    const std::string_view passed(text + place.offset, offset - place.offset);
    const std::size_t lineEnd = passed.rfind('\n');
    place.line += static_cast<std::size_t>(std::count(passed.begin(), passed.end(), '\n'));
    place.column = lineEnd == std::string_view::npos ? place.column + passed.size() : passed.size() - lineEnd;
    place.offset = offset;
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
