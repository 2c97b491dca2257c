#pragma once

#include "Tools/DocTools/VantorPagemeld/System/Diagnostics.h"

#include <rapidjson/document.h>

#include <functional>
#include <optional>
#include <string>
#include <string_view>
#include <variant>

// What a structure check finds, and where.

/// One way in which an input document breaks its format.
enum class StructureFault
{
    // Of an index.
    NotAnObject,
    PagesNotArray,
    InfoNotArray,
    CommonNotObject,
    SearchIndexNotObject,
    PageNotPair,
    PageNotStrings,
    InfoNotPair,
    InfoTextNotString,
    InfoPageNotInt,
    InfoPageOutOfBounds,
    CommonKeyNotString,
    CommonValueNotOne,
    TermNotString,
    TermNotArray,
    PostingNotInt,
    PostingOutOfBounds,

    // Of a node of a toc.
    NodeNotAnObject,
    TitleNotString,
    LinkNotString,
    ChildrenNotList,

    Count,
};

struct StructureFaultRow
{
    StructureFault id;
    int number;       ///< the fixed number of its message
    const char* text; ///< its message without a line break; null for the fault that is reported without one
};

const StructureFaultRow& RowOf(StructureFault fault);

/// A JSON pointer (RFC 6901) to a value: its last step, and a link to the pointer to the value that holds it.
///
/// A walk over a document keeps its pointers on the stack, so that they cost nothing until a fault asks for
/// the text of one. Where an object holds a name twice, pointers to both members have the same text.
class JsonPointer
{
public:
    /// The root of a document.
    JsonPointer() = default;

    /// A member or an element of the value at parent, which must outlive this object; so must the name.
    JsonPointer(const JsonPointer& parent, std::string_view member) : m_parent(&parent), m_step(member) {}
    JsonPointer(const JsonPointer& parent, rapidjson::SizeType element) : m_parent(&parent), m_step(element)
    {
    }

    /// Returns the pointer as text, such as "/pages/3"; empty for the root.
    [[nodiscard]] std::string Text() const;

private:
    [[nodiscard]] std::string StepText() const;

    const JsonPointer* m_parent = nullptr;
    std::variant<std::string_view, rapidjson::SizeType> m_step;
};

/// A fault and where it was found.
struct FoundFault
{
    StructureFault fault;
    const JsonPointer& pointer;    ///< to place
    const rapidjson::Value& place; ///< the faulty value, or the object that lacks a member
    const rapidjson::Value* value; ///< the faulty value; null for a missing member
};

/// Takes each fault that a structure check finds, in document order. Returns whether to go on.
using FaultHandler = std::function<bool(const FoundFault& found)>;

/// Hands over the fault of a value, if it has one. Returns whether to go on.
inline bool HandOver(std::optional<StructureFault> fault, const JsonPointer& pointer,
                     const rapidjson::Value& value, const FaultHandler& onFault)
{
    return !fault || onFault({*fault, pointer, value, &value});
}

/// Hands over the fault of a member, or its absence from the object at pointer. Returns whether to go on.
bool HandOverMember(StructureFault fault, const JsonPointer& pointer, const rapidjson::Value& object,
                    const char* name, const FaultHandler& onFault);

/// A fault handler of the tool: reports the fault as a warning, if it has a message, and stops.
bool WarnAndStop(const Diagnostics& diagnostics, const FoundFault& found);

/// Calls `check(element, pointer)` for each element of an array. Returns false as soon as check does.
template <typename Check>
bool CheckElements(const rapidjson::Value& array, const JsonPointer& pointer, Check check)
{
    for (rapidjson::SizeType i = 0; i < array.Size(); ++i)
    {
        if (!check(array[i], JsonPointer(pointer, i)))
        {
            return false;
        }
    }
    return true;
}
