#include "Tools/DocTools/VantorPagemeld/RapidJsonIoUtil.h"

#include "Tools/DocTools/VantorPagemeld/Read/InputFile.h"
#include "Tools/DocTools/VantorPagemeld/Read/JsonReader.h"
#include "Tools/DocTools/VantorPagemeld/System/Diagnostics.h"

namespace
{

constexpr Diagnostics kDiagnostics("./Tools/DocTools/VantorPagemeld/RapidJsonIoUtil");

void ReportUnopened(const char* path)
{
    kDiagnostics.Warning(23, "Failed to open %s for writing\n", path);
}

} // namespace

namespace RapidJsonIoUtil
{

bool TryGetJsonDocFromFile(const char* path, rapidjson::Document& document)
{
    const InputText text = ReadInputFile(path);
    switch (text.outcome)
    {
    case InputText::Outcome::NotOpened:
        kDiagnostics.Warning(47, "Unable to read %s\n", path);
        return false;
    case InputText::Outcome::NotWhole:
        kDiagnostics.Warning(60, "Unable to read entire file %s, requested %d, got %d bytes\n", path,
                             static_cast<int>(text.size), static_cast<int>(text.bytesRead));
        return false;
    case InputText::Outcome::Read:
        break;
    }
    const rapidjson::ParseResult result = ParseJson(text.bytes.get(), document);
    if (result.IsError())
    {
        kDiagnostics.Error(71, "Failed to parse JSON file %s, error at offset: %d\n", path,
                           static_cast<int>(result.Offset()));
        return false;
    }
    return true;
}

bool TryGetJsonDocFromString(const char* json, rapidjson::Document& document)
{
    return !ParseJson(json, document).IsError();
}

std::string OutputJsonValueToString(const rapidjson::Value& value)
{
    TextBuffer text;
    AppendCompactJson(text, value);
    return text.GetString();
}

SharedOutput JsonOutput(const rapidjson::Value& value)
{
    return {{ReportUnopened, true}, RenderPrettyJson(value)};
}

bool OutputJsonValueToFile(const rapidjson::Value& value, const char* path)
{
    return JsonOutput(value).Write(path, "");
}

} // namespace RapidJsonIoUtil
