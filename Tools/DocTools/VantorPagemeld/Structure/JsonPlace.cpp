#include "Tools/DocTools/VantorPagemeld/Structure/JsonPlace.h"

#include <algorithm>
#include <vector>

std::string JsonPlace::ToPointer() const
{
    std::vector<const JsonPlace*> steps;
    for (const JsonPlace* place = this; place->m_above != nullptr; place = place->m_above)
    {
        steps.push_back(place);
    }
    std::reverse(steps.begin(), steps.end());

    std::string pointer;
    for (const JsonPlace* step : steps)
    {
        pointer += '/';
        pointer += step->StepText();
    }
    return pointer;
}

std::string JsonPlace::StepText() const
{
    if (const auto* element = std::get_if<rapidjson::SizeType>(&m_step))
    {
        return std::to_string(*element);
    }
    std::string escaped;
    for (const char c : std::get<std::string_view>(m_step))
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
