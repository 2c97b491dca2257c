#include "Tools/DocTools/VantorPagemeld/Check/TocStructure.h"

#include "Tools/DocTools/VantorPagemeld/Read/JsonDocument.h"

namespace
{

using rapidjson::Value;

constexpr StructureFault kTitleNotString = {372, "Title is non-string or absent"};
constexpr StructureFault kLinkNotString = {377, "Link is non-string or absent"};
constexpr StructureFault kChildrenNotList = {382, "Children is not an array or null"};

/// Hands over the fault of a member, at the member if the node has one of that name. Returns whether to go
/// on.
bool ReportMember(const Value& node, const JsonPointer& pointer, const char* name,
                  const StructureFault& fault, const FaultHandler& onFault)
{
    const Value* const member = FindMember(node, name);
    return member == nullptr ? onFault(fault, pointer, node) : onFault(fault, {pointer, name}, *member);
}

/// Returns whether to go on.
bool RequireString(const Value& node, const JsonPointer& pointer, const char* name,
                   const StructureFault& fault, const FaultHandler& onFault)
{
    const Value* const member = FindMember(node, name);
    return (member != nullptr && member->IsString()) || ReportMember(node, pointer, name, fault, onFault);
}

bool CheckChildren(const Value& children, const JsonPointer& pointer, const ChildCheck& checkChild)
{
    for (rapidjson::SizeType i = 0; i < children.Size(); ++i)
    {
        if (!checkChild(children[i], {pointer, i}))
        {
            return false;
        }
    }
    return true;
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
        return onFault(kTitleNotString, pointer, node);
    }
    if (!RequireString(node, pointer, "title", kTitleNotString, onFault) ||
        !RequireString(node, pointer, "link", kLinkNotString, onFault))
    {
        return false;
    }
    const Value* const children = FindMember(node, "children");
    if (children == nullptr || (!children->IsNull() && !children->IsArray()))
    {
        return ReportMember(node, pointer, "children", kChildrenNotList, onFault);
    }
    return children->IsNull() || CheckChildren(*children, {pointer, "children"}, checkChild);
}

bool CheckTocStructure(const Value& root, const FaultHandler& onFault)
{
    return CheckSubtree(root, JsonPointer(), onFault);
}
