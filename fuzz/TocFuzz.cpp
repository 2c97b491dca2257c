#include "Tools/DocTools/VantorPagemeld/Json/JsonReader.h"
#include "Tools/DocTools/VantorPagemeld/RapidJsonIoUtil.h"
#include "Tools/DocTools/VantorPagemeld/Structure/TocStructure.h"
#include "Tools/DocTools/VantorPagemeld/TocCombiner.h"
#include "fuzz/Property.h"
#include "fuzz/ScriptForm.h"

#include <cstring>
#include <list>

// Tables of contents that pass the structure check merge as a plain linear merge has it, and both writers say
// what the merged one holds.

namespace
{

using rapidjson::Value;

constexpr const char* kFirstModule =
    R"({"link":"toc","title":"toc","children":[{"link":"null","title":"Classes","children":[)"
    R"({"link":"A","title":"A","children":null},{"link":"a\"\\","title":"\"\\","children":[]}]},)"
    R"({"link":"B","title":"B","module":7,"children":null},{"link":"B","title":"C","children":[]}]})";

/// The merge as the format words it: every entry is searched for from the first on, every value copied.
class PlainMerge
{
public:
    PlainMerge() { m_merged.SetObject(); }

    [[nodiscard]] const Value& Merged() const { return m_merged; }

    void Append(const Value& input, int moduleIndex)
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

private:
    void Tag(Value& node, int moduleIndex)
    {
        node.AddMember("module", moduleIndex, m_merged.GetAllocator());
        Value& children = node["children"];
        for (rapidjson::SizeType i = 0; children.IsArray() && i < children.Size(); ++i)
        {
            Tag(children[i], moduleIndex);
        }
    }

    static bool IsSameEntry(const Value& a, const Value& b)
    {
        return std::strcmp(a["link"].GetString(), b["link"].GetString()) == 0 &&
               std::strcmp(a["title"].GetString(), b["title"].GetString()) == 0;
    }

    static Value* FindEntry(Value& list, const Value& wanted)
    {
        for (Value& entry : list.GetArray())
        {
            if (IsSameEntry(entry, wanted))
            {
                return &entry;
            }
        }
        return nullptr;
    }

    void MergeChildren(Value& destination, Value& source)
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

    rapidjson::Document m_merged;
};

bool IsSound(const Value& document)
{
    int faults = 0;
    Require(CheckTocStructure(document, [&](const StructureFault&, const JsonPlace& place)
                              { return (void)place.ToPointer(), ++faults > 0; }),
            "a check that is told to go on does");
    const bool sound =
        CheckTocStructure(document, [](const StructureFault&, const JsonPlace&) { return false; });
    Require(sound == (faults == 0), "the first fault and all faults agree");
    return sound;
}

void RequireWritersAgree(const TocCombiner& combiner)
{
    const Value& merged = combiner.combinedDocument;
    RequireReadsBack(merged, RapidJsonIoUtil::RenderPrettyJson(merged).GetString());
    Require(IsTocScript(TextOf(combiner.RenderScript(merged).value()), merged), "the script has its form");
}

void RequireMergesLikePlain(const std::vector<std::string>& texts)
{
    std::list<rapidjson::Document> documents; // they hold the values of the merged one
    TocCombiner combiner;
    PlainMerge plain;
    int moduleIndex = 0;
    for (const std::string& text : texts)
    {
        rapidjson::Document& document = documents.emplace_back();
        if (!ParseJson(text.c_str(), document).IsError() && IsSound(document))
        {
            plain.Append(document, moduleIndex);
            combiner.AddModuleIndexToEachEntry(document, moduleIndex);
            combiner.AppendJsonDocument(document);
            ++moduleIndex;
        }
    }
    Require(IsSameValue(combiner.combinedDocument, plain.Merged()), "the merge equals the plain one");
    if (moduleIndex > 0)
    {
        RequireWritersAgree(combiner);
    }
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size)
{
    std::vector<std::string> texts = SplitInput(data, size);
    RequireMergesLikePlain(texts);
    texts.insert(texts.begin(), kFirstModule);
    RequireMergesLikePlain(texts);
    return 0;
}
