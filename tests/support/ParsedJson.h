#pragma once

#include "Tools/DocTools/VantorPagemeld/RapidJsonIoUtil.h"

#include <stdexcept>
#include <string>

/// Returns the document of a JSON text, which must be valid.
inline rapidjson::Document ParsedJson(const std::string& json)
{
    rapidjson::Document document;
    if (!RapidJsonIoUtil::TryGetJsonDocFromString(json.c_str(), document))
    {
        throw std::runtime_error("not JSON: " + json);
    }
    return document;
}
