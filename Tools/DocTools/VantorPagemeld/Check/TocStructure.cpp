#include "Tools/DocTools/VantorPagemeld/Check/TocStructure.h"

#include "Tools/DocTools/VantorPagemeld/Read/JsonDocument.h"

namespace
{

using rapidjson::Value;

/// Returns whether to go on.
bool RequireString(const Value& node, const JsonPointer& pointer, const char* name, StructureFault fault,
                   const FaultHandler& onFault)
{
    const Value* const member = FindMember(node, name);
    return (member != nullptr && member->IsString()) || HandOverMember(fault, pointer, node, name, onFault);
}

bool CheckSubtree(const Value& node, const JsonPointer& pointer, const FaultHandler& onFault)
{
    return CheckTocNode(node, pointer, onFault,
                        [&](const Value& child, const JsonPointer& childPointer)
                        { return CheckSubtree(child, childPointer, onFault); });
}

} // namespace

bool CheckTocNode(const Value& node, const JsonPointer& pointer, const FaultHandler& onFault,
                  const ChildCheck& checkChild)
{
    if (!node.IsObject())
    {
        return HandOver(StructureFault::NodeNotAnObject, pointer, node, onFault);
    }
    if (!RequireString(node, pointer, "title", StructureFault::TitleNotString, onFault) ||
        !RequireString(node, pointer, "link", StructureFault::LinkNotString, onFault))
    {
        return false;
    }
    const Value* const children = FindMember(node, "children");
    if (children == nullptr || (!children->IsNull() && !children->IsArray()))
    {
        return HandOverMember(StructureFault::ChildrenNotList, pointer, node, "children", onFault);
    }
    return children->IsNull() || CheckElements(*children, {pointer, "children"}, checkChild);
}

bool CheckTocStructure(const Value& root, const FaultHandler& onFault)
{
    return CheckSubtree(root, JsonPointer(), onFault);
}
