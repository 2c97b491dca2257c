#pragma once

#include <optional>
#include <string>
#include <string_view>

// Where links between modules lead.
//
// Paths are compared by name, as a browser resolves them: "." and ".." are taken off without looking at
// the disk. Links on disk are not looked at. What a browser asks for does not depend on them, and the same
// pages are often served from a copy in which they are gone. So two names of one directory are two web paths.

/// Returns the web path of a directory: its names without ".", ".." and doubled slashes, and with a slash at
/// the end. It begins with "/" if directory does, and otherwise with "./", after which it may have ".."
/// names: "docs/a/" and "./docs//a" give "./docs/a/", "../x/../b" gives "./../b/", and "/.." gives "/".
///
/// Every character is literal, as in a name on disk. A relative path is relative to a directory that this
/// function does not know, so that its web path equals that of no absolute one.
[[nodiscard]] std::string WebPathOf(std::string_view directory);

/// Returns where a page in fromDirectory leads by the link, in the form of WebPathOf: a directory ends in a
/// slash, a file does not. Returns nothing if the link leads elsewhere, having a scheme or a host of its own.
/// A link whose path is empty leads to fromDirectory, so a prefix can be followed without a page.
///
/// fromDirectory is a path on disk, which the page's address holds without doubled slashes, each character
/// literal. link is a URL reference: "#" and "?" end its path, "%41" is an A, a backslash is a slash, tabs
/// and line breaks are dropped, as are spaces and control characters at either end. An empty name, between
/// two slashes, counts as a directory for a ".." after it; one that no ".." removes is dropped. A ".." above
/// "/" stays there; one above the start of a relative path is kept. Bytes above 0x7F pass as they are.
///
/// So the prefix from one module to another is right if and only if FollowLink(from, prefix) is equal to
/// WebPathOf(to).
[[nodiscard]] std::optional<std::string> FollowLink(std::string_view fromDirectory, std::string_view link);

/// Whether a browser takes the link for an absolute URL: it begins with a letter, then any letters, digits,
/// "+", "-" and ".", and a colon. A file name such as "std::list.html" is one too.
[[nodiscard]] bool HasScheme(std::string_view link);

/// Whether the page script takes the link for an address outside of the documentation: one of http, https,
/// ftp and mailto, in any case. It takes all else for a path.
[[nodiscard]] bool IsAddress(std::string_view link);

/// Returns the path of a file as the page script asks for it: with "%" and two digits for each space, control
/// character, "%", "?" and backslash.
[[nodiscard]] std::string PercentEncoded(std::string_view path);

/// Returns the path with the bytes that "%41" and the like stand for. A "%" without two hexadecimal digits
/// after it stays.
[[nodiscard]] std::string PercentDecoded(std::string_view path);
