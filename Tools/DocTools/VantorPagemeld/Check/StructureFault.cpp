#include "Tools/DocTools/VantorPagemeld/Check/StructureFault.h"

#include "Tools/DocTools/VantorPagemeld/Read/JsonDocument.h"
#include "Tools/DocTools/VantorPagemeld/System/EnumTable.h"

namespace
{

constexpr StructureFaultRow kFaults[] = {
    {StructureFault::NotAnObject, 0, nullptr}, // deliberately reported without a message
    {StructureFault::PagesNotArray, 290, "Pages is not an array or absent"},
    {StructureFault::InfoNotArray, 296, "Info is not an array or absent"},
    {StructureFault::CommonNotObject, 302, "Common is not an object or absent"},
    {StructureFault::SearchIndexNotObject, 308, "SearchIndex is not an object or absent"},
    {StructureFault::PageNotPair, 318, "Content in pages is not an array of 2 elements"},
    {StructureFault::PageNotStrings, 327, "Content in pages sub-element is not a string"},
    {StructureFault::InfoNotPair, 340, "Content in info is not an array of 2 elements"},
    {StructureFault::InfoTextNotString, 345, "1st item in info sub-element is not a string"},
    {StructureFault::InfoPageNotInt, 350, "2nd item in info sub-element is not an int"},
    {StructureFault::InfoPageOutOfBounds, 356, "2nd item in info sub-element is out of bounds"},
    {StructureFault::CommonKeyNotString, 366, "Key in common is not a string"},
    {StructureFault::CommonValueNotOne, 371, "Value in common is not an int(1)"},
    {StructureFault::TermNotString, 382, "Key in searchIndex is not string"},
    {StructureFault::TermNotArray, 387, "Value in searchIndex is not array"},
    {StructureFault::PostingNotInt, 396, "Value in index is not int"},
    {StructureFault::PostingOutOfBounds, 401, "Value in index is out of bounds"},
    {StructureFault::NodeNotAnObject, 372, "Title is non-string or absent"},
    {StructureFault::TitleNotString, 372, "Title is non-string or absent"},
    {StructureFault::LinkNotString, 377, "Link is non-string or absent"},
    {StructureFault::ChildrenNotList, 382, "Children is not an array or null"},
};
static_assert(HasRowOfEach(kFaults));

std::string EscapedPointerName(std::string_view name)
{
    std::string escaped;
    for (const char c : name)
    {
        const bool isEscaped = c == '~' || c == '/';
        escaped += isEscaped ? '~' : c;
        escaped += isEscaped ? (c == '~' ? "0" : "1") : "";
    }
    return escaped;
}

} // namespace

const StructureFaultRow& RowOf(StructureFault fault)
{
    return RowOf(kFaults, fault);
}

bool HandOverMember(StructureFault fault, const JsonPointer& pointer, const rapidjson::Value& object,
                    const char* name, const FaultHandler& onFault)
{
    const rapidjson::Value* const member = FindMember(object, name);
    return member == nullptr ? onFault({fault, pointer, object, nullptr})
                             : onFault({fault, {pointer, name}, *member, member});
}

bool WarnAndStop(const Diagnostics& diagnostics, const FoundFault& found)
{
    const StructureFaultRow& row = RowOf(found.fault);
    if (row.text != nullptr)
    {
        diagnostics.Warning(row.number, "%s\n", row.text);
    }
    return false;
}

std::string JsonPointer::Text() const
{
    std::string reversed;
    for (const JsonPointer* pointer = this; pointer->m_parent != nullptr; pointer = pointer->m_parent)
    {
        const std::string step = pointer->StepText();
        reversed.append(step.rbegin(), step.rend()).append("/");
    }
    return {reversed.rbegin(), reversed.rend()};
}

std::string JsonPointer::StepText() const
{
    const auto* const element = std::get_if<rapidjson::SizeType>(&m_step);
    return element != nullptr ? std::to_string(*element)
                              : EscapedPointerName(std::get<std::string_view>(m_step));
}
