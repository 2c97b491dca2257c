#include "Tools/DocTools/PagemeldCheck/Browse/ScriptLiteral.h"

#include "tests/support/AnswersOfNode.h"

#include <gtest/gtest.h>

#include <random>
#include <utility>

namespace
{

const std::string kBroken = "\xFE"; // no value holds this byte

/// The value of a literal. Evaluates it as the name of a property too, which fails if it ends early.
constexpr const char* kValueInNode = R"(
    const vm = require('vm');
    const surrogate = c => Buffer.of(0xE0 | c >> 12, 0x80 | c >> 6 & 0x3F, 0x80 | c & 0x3F);
    const bytes = c => /^\p{Cs}$/u.test(c) ? surrogate(c.charCodeAt(0)) : Buffer.from(c);
    function answer(literal) {
        try {
            vm.runInThisContext('({' + literal + ': 0})');
            return Buffer.concat(Array.from(vm.runInThisContext('x = ' + literal), bytes));
        } catch { return Buffer.of(0xFE); }
    })";

std::string RandomLiteral(unsigned seed)
{
    const char* const pieces[] = {"\\", "\\", "\\u", "\\x", "\\u{", "\\uD83D",  "\\uDE00",     "\"", "u",
                                  "x",  "{",  "}",   "0",   "1",    "3",        "4",           "8",  "d",
                                  "F",  "n",  "g",   "\r",  "\n",   "\xC3\xA9", "\xE2\x80\xA8"};
    std::mt19937 random(seed);
    std::string literal = "\"";
    for (std::size_t left = random() % 9; left > 0; --left)
    {
        literal += pieces[random() % std::size(pieces)];
    }
    return literal + "\"";
}

} // namespace

TEST(ScriptLiteral, HasTheValueThatAScriptEngineGivesIt)
{
    const std::pair<std::string, std::string> cases[] = {
        {"\"it's \xC3\xA9 \xE2\x80\xA8 \t\x01\"", "it's \xC3\xA9 \xE2\x80\xA8 \t\x01"},
        {R"("\"\" Operator")", "\"\" Operator"},
        {R"("C:\new\table\fig\'\q\8\é")", "C:\new\table\fig'q8é"},
        {"\"a\\\r\nb\\\rc\\\nd\\\xE2\x80\xA8-\\\xE2\x80\xA9-\"", "abcd--"},
        {R"("\x41\xe9\u20aC\u{1F600}\u{00000041}")", "A\xC3\xA9\xE2\x82\xAC\xF0\x9F\x98\x80\x41"},
        {R"("\uD83D\uDE00\ud83d\u{de00}")", "\xF0\x9F\x98\x80\xF0\x9F\x98\x80"},
        {R"("\uD83D-\uDE00\uD83D")", "\xED\xA0\xBD-\xED\xB8\x80\xED\xA0\xBD"},
        {R"("\u{10FFFF}\uDBFF\uDFFF\uD800\uDC00")", "\xF4\x8F\xBF\xBF\xF4\x8F\xBF\xBF\xF0\x90\x80\x80"},
        {R"("\7\18\377\400\60z")", "\7\1\x38\xC3\xBF\x20\x30\x30z"},
        {R"("\08\0001")", std::string("\0\x38\0\x31", 4)},
        {R"("\"\\" Operator")", kBroken},
        {R"("C:\users")", kBroken},
        {R"("\u{110000}")", kBroken},
        {R"("\u{10000000000041}")", kBroken},
        {R"("\")", kBroken},
        {R"("a" + "b")", kBroken},
        {R"("a"; "b")", kBroken},
        {"\"", kBroken},
        {"", kBroken}};
    std::vector<std::string> literals;
    for (const auto& [literal, value] : cases)
    {
        EXPECT_EQ(value, ValueOfScriptLiteral(literal).value_or(kBroken)) << literal;
        literals.push_back(literal);
    }
    for (unsigned seed = 0; seed < 10'000; ++seed)
    {
        literals.push_back(RandomLiteral(seed));
    }
    const std::vector<std::string> values = AnswersOfNode(kValueInNode, literals);
    ASSERT_EQ(literals.size(), values.size());
    for (std::size_t i = 0; i < literals.size(); ++i)
    {
        EXPECT_EQ(values[i], ValueOfScriptLiteral(literals[i]).value_or(kBroken)) << literals[i];
    }
}
