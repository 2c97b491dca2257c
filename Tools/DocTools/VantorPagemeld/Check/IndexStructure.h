#pragma once

#include "Tools/DocTools/VantorPagemeld/Check/StructureFault.h"

#include <rapidjson/document.h>

/// Checks an input search index: the types of its four members, then each entry of pages, info, common and
/// searchIndex, every page and info number against the document's own arrays.
///
/// Hands every fault to onFault: at most one per entry, the first of that entry, at the entry; one per member
/// that is missing (at the document) or of the wrong type (at the member). Numbers that point into such a
/// member are not faults. Returns false as soon as onFault does, and true at the end of the document. Changes
/// nothing.
bool CheckIndexStructure(const rapidjson::Value& document, const FaultHandler& onFault);
