#include "Tools/DocTools/VantorPagemeld/Script/IndexScript.h"

#include "Tools/DocTools/VantorPagemeld/Json/JsonValue.h"
#include "Tools/DocTools/VantorPagemeld/RapidJsonIoUtil.h"
#include "Tools/DocTools/VantorPagemeld/Script/ScriptText.h"

namespace
{

void AppendPage(RenderedText& script, const rapidjson::Value& page)
{
    AppendText(script, "[");
    AppendPrefixVariable(script, page[2].GetInt());
    AppendText(script, " + \"");
    // The page path is deliberately not escaped.
    AppendText(script, CStringOf(page[0]));
    AppendText(script, "\", \"");
    AppendEscapingQuotes(script, CStringOf(page[1]));
    AppendText(script, "\"]");
}

void AppendPages(RenderedText& script, const rapidjson::Value& pages)
{
    AppendText(script, "pages = [\n");
    for (rapidjson::SizeType i = 0; i < pages.Size(); ++i)
    {
        AppendPage(script, pages[i]);
        AppendText(script, i + 1 < pages.Size() ? ",\n" : "\n");
    }
    AppendText(script, "];");
}

} // namespace

RenderedText RenderIndexScript(const rapidjson::Value& index)
{
    RenderedText script;
    AppendPages(script, index["pages"]);
    AppendText(script, "\ninfo = ");
    RapidJsonIoUtil::AppendCompactJson(script, index["info"]);
    // No semicolon behind info: the line break ends that statement, and it is kept so.
    AppendText(script, "\ncommon = ");
    RapidJsonIoUtil::AppendCompactJson(script, index["common"]);
    AppendText(script, ";\nsearchIndex = ");
    RapidJsonIoUtil::AppendCompactJson(script, index["searchIndex"]);
    AppendText(script, ";\n");
    return script;
}
