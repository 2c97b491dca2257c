#include "tests/support/PlainMerge.h"

#include "Tools/DocTools/VantorPagemeld/Read/JsonDocument.h"

#include <cstdlib>
#include <cstring>

using rapidjson::Value;

namespace
{

void Raise(Value& number, int offset, rapidjson::SizeType count)
{
    if (number.GetInt() < 0 || number.GetUint() >= count)
    {
        std::abort(); // the check accepted a number that is out of bounds
    }
    number = number.GetInt() + offset;
}

bool IsSameEntry(const Value& a, const Value& b)
{
    return std::strcmp(a["link"].GetString(), b["link"].GetString()) == 0 &&
           std::strcmp(a["title"].GetString(), b["title"].GetString()) == 0;
}

Value* FindEntry(Value& list, const Value& like)
{
    for (Value& entry : list.GetArray())
    {
        if (IsSameEntry(entry, like))
        {
            return &entry;
        }
    }
    return nullptr;
}

} // namespace

PlainIndexMerge::PlainIndexMerge()
{
    m_merged.Parse(R"({"pages":[],"info":[],"common":{},"searchIndex":{}})");
}

void PlainIndexMerge::Append(const Value& input, int moduleIndex)
{
    const auto pageOffset = static_cast<int>(m_merged["pages"].Size());
    const auto infoOffset = static_cast<int>(m_merged["info"].Size());
    if (m_merged["common"].ObjectEmpty())
    {
        m_merged["common"].CopyFrom(input["common"], m_merged.GetAllocator());
    }
    for (const Value& page : input["pages"].GetArray())
    {
        Push(m_merged["pages"], page).PushBack(moduleIndex, m_merged.GetAllocator());
    }
    for (const Value& info : input["info"].GetArray())
    {
        Raise(Push(m_merged["info"], info)[1], pageOffset, input["pages"].Size());
    }
    for (const auto& term : input["searchIndex"].GetObject())
    {
        Value& postings = PostingsOf(term.name);
        for (const Value& number : term.value.GetArray())
        {
            Raise(Push(postings, number), infoOffset, input["info"].Size());
        }
    }
}

Value& PlainIndexMerge::Push(Value& list, const Value& element)
{
    list.PushBack(Value(element, m_merged.GetAllocator()), m_merged.GetAllocator());
    return list[list.Size() - 1];
}

Value& PlainIndexMerge::PostingsOf(const Value& term)
{
    Value& terms = m_merged["searchIndex"];
    for (auto& known : terms.GetObject())
    {
        if (BytesOf(known.name) == BytesOf(term))
        {
            return known.value;
        }
    }
    terms.AddMember(Value(term, m_merged.GetAllocator()), Value(rapidjson::kArrayType),
                    m_merged.GetAllocator());
    return (terms.MemberEnd() - 1)->value;
}

void PlainTocMerge::Append(const Value& input, int moduleIndex)
{
    Value root(input, m_merged.GetAllocator());
    Tag(root, moduleIndex);
    if (m_merged.ObjectEmpty())
    {
        static_cast<Value&>(m_merged) = root;
    }
    else if (IsSameEntry(m_merged, root))
    {
        MergeChildren(m_merged["children"], root["children"]);
    }
}

void PlainTocMerge::Tag(Value& node, int moduleIndex)
{
    node.AddMember("module", moduleIndex, m_merged.GetAllocator());
    Value& children = node["children"];
    for (rapidjson::SizeType i = 0; children.IsArray() && i < children.Size(); ++i)
    {
        Tag(children[i], moduleIndex);
    }
}

void PlainTocMerge::MergeChildren(Value& destination, Value& source)
{
    if (source.IsArray() && !destination.IsArray())
    {
        destination = source;
        return;
    }
    for (rapidjson::SizeType i = 0; source.IsArray() && i < source.Size(); ++i)
    {
        if (Value* known = FindEntry(destination, source[i]))
        {
            MergeChildren((*known)["children"], source[i]["children"]);
        }
        else
        {
            destination.PushBack(source[i], m_merged.GetAllocator());
        }
    }
}
