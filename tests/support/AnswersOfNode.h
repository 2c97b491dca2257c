#pragma once

#include "tests/support/Files.h"
#include "tests/support/RunProgram.h"

#include <sstream>
#include <string>
#include <vector>

/// Returns what a function of a script makes of each text: answer takes and returns a Buffer. Neither a text
/// nor an answer may hold a byte 0xFF.
inline std::vector<std::string> AnswersOfNode(const std::string& script,
                                              const std::vector<std::string>& texts)
{
    constexpr char kEnd = '\xFF';
    const std::string loop =
        "for (const text of require('fs').readFileSync(process.argv[1], 'latin1').split('\\xFF').slice(0, "
        "-1))"
        "process.stdout.write(Buffer.concat([answer(Buffer.from(text, 'latin1')), Buffer.of(0xFF)]));";
    std::string input;
    for (const std::string& text : texts)
    {
        input += text + kEnd;
    }
    const TemporaryDirectory directory;
    WriteFile(directory / "texts", input);
    std::istringstream output(
        RunProgram(NODE_PROGRAM, {"-e", script + loop, directory / "texts"}).standardOutput);
    std::vector<std::string> answers;
    for (std::string answer; std::getline(output, answer, kEnd);)
    {
        answers.push_back(answer);
    }
    return answers;
}
