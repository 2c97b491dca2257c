#pragma once

#include "Tools/DocTools/VantorPagemeld/Structure/StructureFault.h"

#include <rapidjson/document.h>

#include <functional>

/// Takes each child of a node with its place, in order. Returns whether to go on.
using ChildCheck = std::function<bool(const rapidjson::Value& child, const JsonPlace& place)>;

/// Checks one table-of-contents node: title, then link, then children, which are handed to checkChild unless
/// onFault was told that they are no list.
///
/// Hands every fault of the node itself to onFault. Returns false as soon as onFault or checkChild does.
/// Changes nothing.
bool CheckTocNode(const rapidjson::Value& node, const JsonPlace& place, const FaultHandler& onFault,
                  const ChildCheck& checkChild);

/// Checks a whole table of contents, depth first: CheckTocNode for the root and everything below it. Hands
/// every fault to onFault; returns false as soon as onFault does, and true at the end of the tree.
bool CheckTocStructure(const rapidjson::Value& root, const FaultHandler& onFault);
