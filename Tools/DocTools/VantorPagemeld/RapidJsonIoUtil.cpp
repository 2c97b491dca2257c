#include "Tools/DocTools/VantorPagemeld/RapidJsonIoUtil.h"

#include "Tools/DocTools/VantorPagemeld/Json/JsonReader.h"
#include "Tools/DocTools/VantorPagemeld/Output/Diagnostics.h"
#include "Tools/DocTools/VantorPagemeld/Output/ScopedFile.h"

#include <rapidjson/prettywriter.h>
#include <rapidjson/writer.h>

#include <cstdint>
#include <memory>
#include <new>
#include <utility>

#include <sys/stat.h>

namespace
{

constexpr Diagnostics kDiagnostics("./Tools/DocTools/VantorPagemeld/RapidJsonIoUtil");

/// The parser counts in 32 bits.
constexpr long kMaxFileSize = UINT32_MAX;

using FileText = std::unique_ptr<char[]>;

/// Returns the size in bytes, or -1 for what has none: a folder, whatever its file system says, or a pipe.
/// Leaves the stream at its start.
long SizeOf(std::FILE* file)
{
    struct stat status = {};
    if (::fstat(::fileno(file), &status) != 0 || S_ISDIR(status.st_mode) ||
        std::fseek(file, 0, SEEK_END) != 0)
    {
        return -1;
    }
    const long size = std::ftell(file);
    std::rewind(file);
    return size;
}

/// Returns size + 1 bytes that are not set yet, or null when the size is out of bounds or there is no memory.
FileText AllocateText(long size)
{
    return FileText(size >= 0 && size <= kMaxFileSize
                        ? new (std::nothrow) char[static_cast<std::size_t>(size) + 1]
                        : nullptr);
}

/// Returns the whole of an open file with a NUL behind it, or null, after a warning, when it can't be had.
FileText ReadWhole(std::FILE* file, const char* path)
{
    const long size = SizeOf(file);
    FileText text = AllocateText(size);
    const std::size_t bytesRead =
        text == nullptr ? 0 : std::fread(text.get(), 1, static_cast<std::size_t>(size), file);
    if (text == nullptr || bytesRead != static_cast<std::size_t>(size))
    {
        kDiagnostics.Warning(60, "Unable to read entire file %s, requested %d, got %d bytes\n", path,
                             static_cast<int>(size), static_cast<int>(bytesRead));
        return nullptr;
    }
    text[bytesRead] = '\0';
    return text;
}

/// Returns the whole of the file at path with a NUL behind it, or null, after a warning, when it can't be
/// had.
FileText ReadFile(const char* path)
{
    const ScopedFile file = OpenForReading(path);
    if (file == nullptr)
    {
        kDiagnostics.Warning(47, "Unable to read %s\n", path);
        return nullptr;
    }
    return ReadWhole(file.get(), path);
}

} // namespace

namespace RapidJsonIoUtil
{

bool TryGetJsonDocFromFile(const char* path, rapidjson::Document& document)
{
    const FileText text = ReadFile(path);
    if (text == nullptr)
    {
        return false;
    }
    const rapidjson::ParseResult result = ParseJson(text.get(), document);
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
    RenderedText text;
    AppendCompactJson(text, value);
    return text.GetString();
}

RenderedText RenderPrettyJson(const rapidjson::Value& value)
{
    RenderedText text;
    rapidjson::PrettyWriter<RenderedText> writer(text);
    value.Accept(writer);
    return text;
}

void AppendCompactJson(RenderedText& text, const rapidjson::Value& value)
{
    rapidjson::Writer<RenderedText> writer(text);
    value.Accept(writer);
}

bool OutputJsonValueToFile(const rapidjson::Value& value, const char* path)
{
    RepeatedText json(RenderPrettyJson(value));
    return OutputJsonTextToFile(json, path);
}

bool OutputJsonTextToFile(RepeatedText& json, const char* path)
{
    ScopedFile file = OpenForWriting(path);
    if (file == nullptr)
    {
        kDiagnostics.Warning(23, "Failed to open %s for writing\n", path);
        return false;
    }
    json.WriteTo(std::move(file));
    return true;
}

} // namespace RapidJsonIoUtil
