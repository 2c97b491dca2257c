#pragma once

#include <rapidjson/document.h>

#include <functional>
#include <string>
#include <string_view>
#include <variant>

// What a structure check finds, and where.

/// One way in which an input document breaks its format.
struct StructureFault
{
    int number;       ///< the fixed number of its message
    const char* text; ///< its message without a line break; null for the fault that is reported without one
};

/// A JSON pointer (RFC 6901) to a value, as a step from the pointer to the value that holds it.
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

/// Takes each fault that a structure check finds, in document order: with the faulty value, or the object
/// that lacks a member, and the pointer to it. Returns whether to go on.
using FaultHandler = std::function<bool(const StructureFault& fault, const JsonPointer& pointer,
                                        const rapidjson::Value& value)>;
