#pragma once

#include "Tools/DocTools/VantorPagemeld/Output/RenderedText.h"

#include <rapidjson/document.h>

#include <optional>

/// How global_toc.js is laid out. The program writes the compact form, with both options off.
struct TocScriptLayout
{
    bool lineBreaks = false;  ///< a "\n" behind every value, bracket and comma
    bool indentation = false; ///< blanks before keys, brackets and commas, by their depth
};

/// Returns what follows the prefix variables in global_toc.js; it is the same in every module. Nothing if the
/// root has no "link" or no "title".
///
/// toc is the root of a combined table of contents. Texts end at their first NUL. Of the root only link,
/// title and children are written, its link without a prefix.
std::optional<RenderedText> RenderTocScript(const rapidjson::Value& toc, const TocScriptLayout& layout);

/// Appends one node, or the nodes of one list, at a depth of indent blanks; nothing for any other value.
///
/// The link of a node that has a module is written behind the module's prefix variable, with nothing escaped,
/// unless it is "null"; other links and all titles have their double quotes escaped. This is wanted.
void AppendTocValue(RenderedText& script, const rapidjson::Value& value, int indent,
                    const TocScriptLayout& layout);

/// Appends text in double quotes, its own escaped, then extra; blanks before and a "\n" behind as layout and
/// newLine say.
void AppendTocString(RenderedText& script, const char* text, const char* extra, int indent, bool newLine,
                     const TocScriptLayout& layout);
