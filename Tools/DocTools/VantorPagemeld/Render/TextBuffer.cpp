#include "Tools/DocTools/VantorPagemeld/Render/TextBuffer.h"

#include <rapidjson/prettywriter.h>
#include <rapidjson/writer.h>

#include <cstring>

std::string_view TextOf(const TextBuffer& buffer)
{
    return {buffer.GetString(), buffer.GetSize()};
}

void AppendText(TextBuffer& buffer, std::string_view text)
{
    if (!text.empty()) // an empty view may be of null, from which memcpy must not copy even nothing
    {
        std::memcpy(buffer.Push(text.size()), text.data(), text.size());
    }
}

void AppendTitleLiteral(TextBuffer& buffer, const char* text)
{
    AppendText(buffer, "\"");
    std::string_view rest = text; // up to the first NUL: what comes after it is in no script
    for (std::size_t quote = rest.find('"'); quote != std::string_view::npos; quote = rest.find('"'))
    {
        AppendText(buffer, rest.substr(0, quote));
        AppendText(buffer, "\\\"");
        rest.remove_prefix(quote + 1);
    }
    AppendText(buffer, rest);
    AppendText(buffer, "\"");
}

void AppendPathLiteral(TextBuffer& buffer, const char* text)
{
    AppendText(buffer, "\"");
    AppendText(buffer, text);
    AppendText(buffer, "\"");
}

void AppendCompactJson(TextBuffer& buffer, const rapidjson::Value& value)
{
    rapidjson::Writer<TextBuffer> writer(buffer);
    value.Accept(writer); // can't fail: the reader refuses the infinities that no writer takes
}

TextBuffer RenderPrettyJson(const rapidjson::Value& value)
{
    TextBuffer buffer;
    rapidjson::PrettyWriter<TextBuffer> writer(buffer); // four spaces a level unless told otherwise
    value.Accept(writer);
    return buffer;
}
