#pragma once

#include "Tools/DocTools/VantorPagemeld/Check/StructureFault.h"

#include <rapidjson/document.h>

#include <functional>

/// Takes each child of a node with its pointer, in order. Returns whether to go on.
using ChildCheck = std::function<bool(const rapidjson::Value& child, const JsonPointer& pointer)>;

/// Checks one table-of-contents node: title, then link, then children. Each child of a list is handed to
/// checkChild.
///
/// Hands every fault of the node itself to onFault: one per member that is missing (at the node) or of the
/// wrong type (at the member), or a single one for a node that is not an object. Returns false as soon as
/// onFault or checkChild does. Changes nothing.
bool CheckTocNode(const rapidjson::Value& node, const JsonPointer& pointer, const FaultHandler& onFault,
                  const ChildCheck& checkChild);

/// Checks a whole table of contents, depth first: CheckTocNode for the root and everything below it. Hands
/// every fault to onFault; returns false as soon as onFault does, and true at the end of the tree.
bool CheckTocStructure(const rapidjson::Value& root, const FaultHandler& onFault);
