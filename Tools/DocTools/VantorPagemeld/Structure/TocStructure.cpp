#include "Tools/DocTools/VantorPagemeld/Structure/TocStructure.h"

#include "Tools/DocTools/VantorPagemeld/Json/JsonValue.h"

namespace
{

constexpr StructureFault kNoTitle = {372, "Title is non-string or absent"};
constexpr StructureFault kNoLink = {377, "Link is non-string or absent"};
constexpr StructureFault kNoChildren = {382, "Children is not an array or null"};

bool IsStringMember(const rapidjson::Value& node, const char* name)
{
    const rapidjson::Value* member = FindMember(node, name);
    return member != nullptr && member->IsString();
}

bool CheckSubtree(const rapidjson::Value& node, const JsonPlace& place, const FaultHandler& onFault)
{
    return CheckTocNode(node, place, onFault,
                        [&](const rapidjson::Value& child, const JsonPlace& childPlace)
                        { return CheckSubtree(child, childPlace, onFault); });
}

} // namespace

bool CheckTocNode(const rapidjson::Value& node, const JsonPlace& place, const FaultHandler& onFault,
                  const ChildCheck& checkChild)
{
    if (!IsStringMember(node, "title") && !onFault(kNoTitle, place))
    {
        return false;
    }
    if (!IsStringMember(node, "link") && !onFault(kNoLink, place))
    {
        return false;
    }
    const rapidjson::Value* children = FindMember(node, "children");
    if (children == nullptr || (!children->IsNull() && !children->IsArray()))
    {
        return onFault(kNoChildren, place);
    }
    if (children->IsNull())
    {
        return true;
    }
    const JsonPlace list(place, "children");
    for (rapidjson::SizeType i = 0; i < children->Size(); ++i)
    {
        if (!checkChild((*children)[i], {list, i}))
        {
            return false;
        }
    }
    return true;
}

bool CheckTocStructure(const rapidjson::Value& root, const FaultHandler& onFault)
{
    return CheckSubtree(root, JsonPlace(), onFault);
}
