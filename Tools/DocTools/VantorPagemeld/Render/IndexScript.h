#pragma once

#include "Tools/DocTools/VantorPagemeld/Render/TextBuffer.h"

#include <rapidjson/document.h>

/// Returns what comes after the prefix variables in global_index.js; it is the same in every module.
///
/// index is a combined search index whose pages are tagged with their module. Page titles and paths end at
/// their first NUL. Titles have their double quotes escaped, page paths nothing at all; the three other
/// members are JSON.
[[nodiscard]] TextBuffer RenderIndexScript(const rapidjson::Value& index);
