#pragma once

#include "Tools/DocTools/VantorPagemeld/Render/TextBuffer.h"

#include <rapidjson/document.h>

/// How global_toc.js is laid out. The program writes the compact form, with both options off.
struct TocScriptLayout
{
    bool lineBreaks = false;  ///< a "\n" after every value, bracket and comma
    bool indentation = false; ///< spaces before keys, brackets and commas, by their depth
};

/// Returns what comes after the prefix variables in global_toc.js; it is the same in every module.
///
/// toc is the root of a combined table of contents, with a link and a title. Texts end at their first NUL. Of
/// the root only link, title and children are written, its link without a prefix.
[[nodiscard]] TextBuffer RenderTocScript(const rapidjson::Value& toc, const TocScriptLayout& layout = {});

/// Appends one node, or the nodes of one list, at a depth of indent spaces; nothing for any other value.
///
/// The forms of a link differ intentionally:
/// - of a node that has a module: after the module's prefix variable, with nothing escaped
/// - the same, but "null": without a prefix
/// - of a node that has none: with its double quotes escaped, as in all titles
void AppendTocValue(TextBuffer& script, const rapidjson::Value& value, int indent,
                    const TocScriptLayout& layout);

/// Appends text in double quotes, with those inside it escaped, then extra; spaces before and a "\n" after it
/// as layout and newLine say.
void AppendTocString(TextBuffer& script, const char* text, const char* extra, int indent, bool newLine,
                     const TocScriptLayout& layout);
