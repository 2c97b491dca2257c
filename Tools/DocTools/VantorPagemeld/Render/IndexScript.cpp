#include "Tools/DocTools/VantorPagemeld/Render/IndexScript.h"

#include "Tools/DocTools/VantorPagemeld/Read/JsonDocument.h"
#include "Tools/DocTools/VantorPagemeld/Render/ModulePrefix.h"

// The paths of pages are expressions, so no JSON writer can write pages. The three other members are JSON.

namespace
{

void AppendPage(TextBuffer& script, const rapidjson::Value& page)
{
    AppendText(script, "[");
    AppendText(script, PrefixVariable(page[2].GetInt())); // the module, which tagging has appended
    AppendText(script, " + ");
    AppendPathLiteral(script, CStringOf(page[0]));
    AppendText(script, ", ");
    AppendTitleLiteral(script, CStringOf(page[1]));
    AppendText(script, "]");
}

void AppendPages(TextBuffer& script, const rapidjson::Value& pages)
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

TextBuffer RenderIndexScript(const rapidjson::Value& index)
{
    TextBuffer script;
    AppendPages(script, index["pages"]);
    AppendText(script, "\ninfo = ");
    AppendCompactJson(script, index["info"]);
    // No semicolon after info, on purpose: the line break ends that statement.
    AppendText(script, "\ncommon = ");
    AppendCompactJson(script, index["common"]);
    AppendText(script, ";\nsearchIndex = ");
    AppendCompactJson(script, index["searchIndex"]);
    AppendText(script, ";\n");
    return script;
}
