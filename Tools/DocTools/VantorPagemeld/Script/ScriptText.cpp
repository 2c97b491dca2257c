#include "Tools/DocTools/VantorPagemeld/Script/ScriptText.h"

#include <string>

void AppendEscapingQuotes(RenderedText& script, std::string_view text)
{
    std::string_view rest = text;
    for (std::size_t quote = rest.find('"'); quote != std::string_view::npos; quote = rest.find('"'))
    {
        AppendText(script, rest.substr(0, quote));
        AppendText(script, "\\\"");
        rest.remove_prefix(quote + 1);
    }
    AppendText(script, rest);
}

void AppendPrefixVariable(RenderedText& script, int moduleIndex)
{
    AppendText(script, "p");
    AppendText(script, std::to_string(moduleIndex));
}
