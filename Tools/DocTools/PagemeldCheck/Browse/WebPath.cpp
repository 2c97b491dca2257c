#include "Tools/DocTools/PagemeldCheck/Browse/WebPath.h"

#include <algorithm>
#include <charconv>
#include <iterator>

#include <strings.h>

// Inside this file a path is a URL path: "%" introduces a byte, and a name may be empty. It begins with "/"
// or "./", and ends in a slash as long as names are added. Only the finished path is converted to names on
// disk.

namespace
{

bool IsLetter(char c)
{
    return (c >= 'a' && c <= 'z') || (c >= 'A' && c <= 'Z');
}

bool IsSchemeCharacter(char c)
{
    return IsLetter(c) || (c >= '0' && c <= '9') || c == '+' || c == '-' || c == '.';
}

bool IsSpaceOrControl(char c)
{
    return static_cast<unsigned char>(c) <= ' ';
}

bool EndsWith(std::string_view text, std::string_view end)
{
    return text.size() >= end.size() && text.substr(text.size() - end.size()) == end;
}

/// Returns the link without what a URL parser drops from any input.
std::string Cleaned(std::string_view link)
{
    const auto first = std::find_if_not(link.begin(), link.end(), IsSpaceOrControl);
    const auto last = std::find_if_not(link.rbegin(), std::make_reverse_iterator(first), IsSpaceOrControl);
    std::string cleaned;
    std::copy_if(first, last.base(), std::back_inserter(cleaned),
                 [](char c) { return c != '\t' && c != '\n' && c != '\r'; });
    return cleaned;
}

std::string WithoutDoubledSlashes(std::string path)
{
    const auto end =
        std::unique(path.begin(), path.end(), [](char a, char b) { return a == '/' && b == '/'; });
    path.erase(end, path.end());
    return path;
}

std::string Encoded(std::string_view path)
{
    std::string encoded;
    for (const char c : path)
    {
        encoded.append(c == '%' ? "%25" : std::string_view(&c, 1));
    }
    return encoded;
}

void Climb(std::string& path)
{
    if (path == "./" || EndsWith(path, "/../"))
    {
        path += "../";
    }
    else if (path != "/")
    {
        path.erase(path.rfind('/', path.size() - 2) + 1);
    }
}

/// Returns where the steps lead from the directory at path. Steps may be written in encoded form: a URL
/// parser takes "%2e" for a dot.
std::string Resolve(std::string path, std::string_view steps)
{
    for (bool isLast = false; !isLast;)
    {
        const std::size_t slash = steps.find('/');
        const std::string_view step = steps.substr(0, slash);
        const std::string name = PercentDecoded(step);
        isLast = slash == std::string_view::npos;
        if (name == "..")
        {
            Climb(path);
        }
        else if (name != ".")
        {
            path.append(step).append(isLast ? "" : "/");
        }
        steps.remove_prefix(isLast ? 0 : slash + 1);
    }
    return path;
}

/// Returns where the path leads from the directory at start, or from "/" if it begins there.
std::string ResolvePath(const std::string& start, std::string_view path)
{
    const bool isAbsolute = path.substr(0, 1) == "/";
    return Resolve(isAbsolute ? "/" : start, path.substr(isAbsolute ? 1 : 0));
}

/// Returns the path that the address of a page in the directory has. Only "%" needs an escape, since the path
/// is never again parsed as a part of a URL.
std::string AddressOf(std::string_view directory)
{
    const std::string address = ResolvePath("./", Encoded(WithoutDoubledSlashes(std::string(directory))));
    return EndsWith(address, "/") ? address : address + "/";
}

} // namespace

std::string WebPathOf(std::string_view directory)
{
    return PercentDecoded(AddressOf(directory));
}

std::optional<std::string> FollowLink(std::string_view fromDirectory, std::string_view link)
{
    std::string reference = Cleaned(link);
    if (HasScheme(reference))
    {
        return std::nullopt;
    }
    reference.erase(std::min(reference.find_first_of("?#"), reference.size()));
    std::replace(reference.begin(), reference.end(), '\\', '/');
    if (reference.compare(0, 2, "//") == 0)
    {
        return std::nullopt;
    }
    return PercentDecoded(WithoutDoubledSlashes(ResolvePath(AddressOf(fromDirectory), reference)));
}

bool HasScheme(std::string_view link)
{
    if (link.find(':') == std::string_view::npos)
    {
        return false;
    }
    const std::string cleaned = Cleaned(link);
    const auto end = std::find_if_not(cleaned.begin(), cleaned.end(), IsSchemeCharacter);
    return IsLetter(cleaned.front()) && *end == ':';
}

bool IsAddress(std::string_view link)
{
    constexpr std::string_view kSchemes[] = {"http", "https", "ftp", "mailto"};
    const std::size_t colon = link.find(':');
    return std::any_of(std::begin(kSchemes), std::end(kSchemes),
                       [&](std::string_view scheme) {
                           return scheme.size() == colon &&
                                  ::strncasecmp(scheme.data(), link.data(), colon) == 0;
                       });
}

std::string PercentEncoded(std::string_view path)
{
    constexpr std::string_view kDigits = "0123456789ABCDEF";
    std::string encoded;
    for (const char c : path)
    {
        const auto byte = static_cast<unsigned char>(c);
        if (byte > ' ' && c != '%' && c != '?' && c != '\\')
        {
            encoded += c;
            continue;
        }
        encoded += {'%', kDigits[byte >> 4U], kDigits[byte & 0xFU]};
    }
    return encoded;
}

std::string PercentDecoded(std::string_view path)
{
    std::string decoded;
    for (std::size_t i = 0; i < path.size(); ++i)
    {
        unsigned char byte = 0;
        const std::string_view digits = path.substr(i + 1, 2);
        const bool isEncoded = path[i] == '%' && digits.size() == 2 &&
                               std::from_chars(digits.begin(), digits.end(), byte, 16).ptr == digits.end();
        decoded += isEncoded ? static_cast<char>(byte) : path[i];
        i += isEncoded ? 2 : 0;
    }
    return decoded;
}
