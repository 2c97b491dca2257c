#pragma once

#include <optional>
#include <string>
#include <string_view>

/// Returns the value of a JavaScript string literal, or nothing when the text is not one whole literal in
/// double quotes: it ends early, never ends, or has an escape that a script engine refuses.
///
/// literal is in UTF-8, with its quotes, as a script that is not in strict mode holds it. The value is in
/// UTF-8 too. Half of a surrogate pair, which only an escape can make, becomes the three bytes that its
/// number would have; two halves in a row become their character. Every escape is longer than what it makes,
/// so a title or link that holds a backslash never comes back unchanged.
///
/// Bytes that are not UTF-8 are kept. A browser shows U+FFFD for them, but they end no literal.
[[nodiscard]] std::optional<std::string> ValueOfScriptLiteral(std::string_view literal);
