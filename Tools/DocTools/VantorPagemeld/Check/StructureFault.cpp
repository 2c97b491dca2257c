#include "Tools/DocTools/VantorPagemeld/Check/StructureFault.h"

#include <algorithm>
#include <vector>

namespace
{

std::string EscapedPointerName(std::string_view name)
{
    std::string escaped;
    for (const char c : name)
    {
        switch (c)
        {
        case '~':
            escaped += "~0";
            break;
        case '/':
            escaped += "~1";
            break;
        default:
            escaped += c;
        }
    }
    return escaped;
}

} // namespace

std::string JsonPointer::Text() const
{
    std::vector<const JsonPointer*> steps;
    for (const JsonPointer* pointer = this; pointer->m_parent != nullptr; pointer = pointer->m_parent)
    {
        steps.push_back(pointer);
    }
    std::string text;
    std::for_each(steps.rbegin(), steps.rend(),
                  [&](const JsonPointer* step) { text.append("/").append(step->StepText()); });
    return text;
}

std::string JsonPointer::StepText() const
{
    const auto* const element = std::get_if<rapidjson::SizeType>(&m_step);
    return element != nullptr ? std::to_string(*element)
                              : EscapedPointerName(std::get<std::string_view>(m_step));
}
