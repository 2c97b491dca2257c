#pragma once

#include <rapidjson/document.h>

#include <string>
#include <string_view>
#include <variant>

/// A place in a JSON document: a step from the place above it. A walk keeps its places on the stack, so that
/// they cost nothing until a fault asks for one.
class JsonPlace
{
public:
    /// The root of a document.
    JsonPlace() = default;

    /// A member or an element of the value at above, which must outlive this object; so must the name.
    JsonPlace(const JsonPlace& above, std::string_view member) : m_above(&above), m_step(member) {}
    JsonPlace(const JsonPlace& above, rapidjson::SizeType element) : m_above(&above), m_step(element) {}

    /// Returns the place as a JSON Pointer (RFC 6901), such as "/pages/3"; an empty text for the root.
    [[nodiscard]] std::string ToPointer() const;

private:
    [[nodiscard]] std::string StepText() const;

    const JsonPlace* m_above = nullptr;
    std::variant<std::string_view, rapidjson::SizeType> m_step;
};
