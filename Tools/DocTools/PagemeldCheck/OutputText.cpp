#include "Tools/DocTools/PagemeldCheck/OutputText.h"

#include "Tools/DocTools/VantorPagemeld/Read/JsonReader.h"

#include <string>

namespace
{

/// What shows that a script is whole. Its end alone does not: a line in the middle can end in the same way,
/// so a script that was cut there would pass. Only a whole one has the last part too.
struct ScriptMarks
{
    std::string_view bodyStart; ///< after the prefix lines
    std::string_view lastPart;  ///< where its last statement or line begins
    std::string_view bodyEnd;
};

constexpr ScriptMarks kIndexScript = {"pages = [\n", "\nsearchIndex = {", "};\n"};
constexpr ScriptMarks kTocScript = {"toc = {\n", "\n\"link\": ", "]};\n"};

const ScriptMarks& MarksOf(Output script)
{
    return script == Output::IndexScript ? kIndexScript : kTocScript;
}

} // namespace

std::size_t FindBody(const OutputRow& output, std::string_view text)
{
    if (output.form == OutputRow::Form::Json)
    {
        return 0;
    }
    const std::string_view bodyStart = MarksOf(output.id).bodyStart;
    const std::size_t lineEnd = text.find("\n" + std::string(bodyStart));
    return text.substr(0, bodyStart.size()) == bodyStart ? 0
           : lineEnd == std::string_view::npos           ? lineEnd
                                                         : lineEnd + 1;
}

bool IsWholeBody(const OutputRow& output, std::string_view body)
{
    if (output.form == OutputRow::Form::Json)
    {
        rapidjson::Document document;
        return !ParseJson(body.data(), document).IsError();
    }
    const ScriptMarks& marks = MarksOf(output.id);
    return body.find(marks.lastPart) != std::string_view::npos &&
           body.substr(body.size() - marks.bodyEnd.size()) == marks.bodyEnd;
}
