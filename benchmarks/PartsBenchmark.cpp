/// Times the parts of a combining run one by one, so that a regression can be placed.
///
/// The documents are made here, in the shape of one middling module; words follow Zipf's law. Each rate is in
/// bytes of the JSON text that the part reads or that it writes.

#include "Tools/DocTools/VantorPagemeld/IndexCombiner.h"
#include "Tools/DocTools/VantorPagemeld/Memory/Heap.h"
#include "Tools/DocTools/VantorPagemeld/RapidJsonIoUtil.h"
#include "Tools/DocTools/VantorPagemeld/Script/IndexScript.h"
#include "Tools/DocTools/VantorPagemeld/Script/RelativePrefix.h"
#include "Tools/DocTools/VantorPagemeld/TocCombiner.h"

#include <benchmark/benchmark.h>

#include <cmath>
#include <map>
#include <random>
#include <string>
#include <vector>

namespace
{

constexpr int kModules = 4;
constexpr int kPages = 4'000;
constexpr int kWordsPerPage = 32;
constexpr double kVocabulary = 20'000;
constexpr int kGroups = 100;

/// Returns a number from 0 to kVocabulary - 1 by Zipf's law: the logarithm of its rank is evenly distributed.
/// The generator's sequence is fixed by the language, unlike that of a distribution.
int DrawWord(std::mt19937& random)
{
    const double even = static_cast<double>(random()) / 4'294'967'296.0;
    return static_cast<int>(std::pow(kVocabulary, even)) - 1;
}

std::string Quoted(const std::string& text)
{
    return '"' + text + '"';
}

std::string Joined(const std::vector<std::string>& texts)
{
    std::string joined;
    for (const std::string& text : texts)
    {
        joined += joined.empty() ? text : ", " + text;
    }
    return joined;
}

std::string MakeIndexText(int module)
{
    std::mt19937 random(static_cast<unsigned>(module));
    std::vector<std::string> pages;
    std::vector<std::string> infos;
    std::map<int, std::vector<std::string>> infosOfWord;
    for (int page = 0; page < kPages; ++page)
    {
        const std::string number = std::to_string(page);
        std::string text;
        for (int i = 0; i < kWordsPerPage; ++i)
        {
            const int word = DrawWord(random);
            text += "word" + std::to_string(word) + ' ';
            infosOfWord[word].push_back(number);
        }
        pages.push_back("[\"page-" + number + ".html\", \"Page " + number + "\"]");
        infos.push_back('[' + Quoted(text) + ", " + number + ']');
    }
    std::vector<std::string> terms;
    terms.reserve(infosOfWord.size());
    for (const auto& [word, numbers] : infosOfWord)
    {
        terms.push_back(Quoted("word" + std::to_string(word)) + ": [" + Joined(numbers) + ']');
    }
    return R"({"pages": [)" + Joined(pages) + R"(], "info": [)" + Joined(infos) +
           R"(], "common": {"the": 1}, "searchIndex": {)" + Joined(terms) + "}}";
}

std::string MakeNode(const std::string& link, const std::string& title, const std::string& children)
{
    return R"({"link": )" + Quoted(link) + R"(, "title": )" + Quoted(title) + R"(, "children": )" + children +
           '}';
}

/// Groups that all modules share, each with pages of which every second is the module's own.
std::string MakeTocText(int module)
{
    std::vector<std::string> groups;
    for (int group = 0; group < kGroups; ++group)
    {
        std::vector<std::string> pages;
        for (int page = 0; page < kPages / kGroups; ++page)
        {
            const std::string owner = page % 2 == 0 ? "shared" : std::to_string(module);
            const std::string name = std::to_string(group) + '-' + std::to_string(page) + '-' + owner;
            pages.push_back(MakeNode("page-" + name + ".html", "Page " + name, "null"));
        }
        groups.push_back(MakeNode("null", "Group " + std::to_string(group), '[' + Joined(pages) + ']'));
    }
    return MakeNode("toc", "toc", '[' + Joined(groups) + ']');
}

/// One kind of combiner with the texts of its modules.
template <class Combiner>
struct Texts;

template <>
struct Texts<IndexCombiner>
{
    static std::string Make(int module) { return MakeIndexText(module); }
};

template <>
struct Texts<TocCombiner>
{
    static std::string Make(int module) { return MakeTocText(module); }
};

template <class Combiner>
const std::string& TextOfModule(int module)
{
    static const std::vector<std::string> texts = []
    {
        std::vector<std::string> made;
        made.reserve(kModules);
        for (int i = 0; i < kModules; ++i)
        {
            made.push_back(Texts<Combiner>::Make(i));
        }
        return made;
    }();
    return texts[static_cast<std::size_t>(module)];
}

template <class Combiner>
void ParseModule(int module, rapidjson::Document& document)
{
    if (!RapidJsonIoUtil::TryGetJsonDocFromString(TextOfModule<Combiner>(module).c_str(), document))
    {
        std::abort();
    }
}

void CountBytes(benchmark::State& state, std::size_t bytesPerIteration)
{
    state.SetBytesProcessed(state.iterations() * static_cast<std::int64_t>(bytesPerIteration));
}

/// A combiner that has merged all modules, with the documents that its values lie in.
template <class Combiner>
struct Combined
{
    std::vector<rapidjson::Document> documents{kModules};
    Combiner combiner;
    std::size_t inputBytes = 0;

    /// Parses and tags the documents, without merging them.
    void Load()
    {
        for (int module = 0; module < kModules; ++module)
        {
            rapidjson::Document& document = documents[static_cast<std::size_t>(module)];
            ParseModule<Combiner>(module, document);
            combiner.AddModuleIndexToEachEntry(document, module);
            inputBytes += TextOfModule<Combiner>(module).size();
        }
    }

    void Merge()
    {
        for (rapidjson::Document& document : documents)
        {
            combiner.AppendJsonDocument(document);
        }
    }
};

template <class Combiner>
const Combined<Combiner>& AllModules()
{
    static const Combined<Combiner>& combined = []() -> const Combined<Combiner>&
    {
        static Combined<Combiner> made;
        made.Load();
        made.Merge();
        return made;
    }();
    return combined;
}

template <class Combiner>
void Parse(benchmark::State& state)
{
    while (state.KeepRunning())
    {
        rapidjson::Document document;
        ParseModule<Combiner>(0, document);
        benchmark::DoNotOptimize(document);
    }
    CountBytes(state, TextOfModule<Combiner>(0).size());
}

template <class Combiner>
void Validate(benchmark::State& state)
{
    rapidjson::Document document;
    ParseModule<Combiner>(0, document);
    Combiner combiner;
    while (state.KeepRunning())
    {
        if (!combiner.VerifyJSONStructure(document))
        {
            state.SkipWithError("the document was refused");
            break;
        }
    }
    CountBytes(state, TextOfModule<Combiner>(0).size());
}

template <class Combiner>
void Tag(benchmark::State& state)
{
    while (state.KeepRunning())
    {
        state.PauseTiming();
        {
            rapidjson::Document document;
            Combiner combiner;
            ParseModule<Combiner>(0, document);
            state.ResumeTiming();
            combiner.AddModuleIndexToEachEntry(document, 0);
            state.PauseTiming();
        }
        state.ResumeTiming();
    }
    CountBytes(state, TextOfModule<Combiner>(0).size());
}

template <class Combiner>
void Merge(benchmark::State& state)
{
    std::size_t bytes = 0;
    while (state.KeepRunning())
    {
        state.PauseTiming();
        {
            Combined<Combiner> combined;
            combined.Load();
            bytes = combined.inputBytes;
            state.ResumeTiming();
            combined.Merge();
            state.PauseTiming();
        }
        state.ResumeTiming();
    }
    CountBytes(state, bytes);
}

template <class Combiner>
void RenderJson(benchmark::State& state)
{
    const rapidjson::Document& document = AllModules<Combiner>().combiner.combinedDocument;
    std::size_t bytes = 0;
    while (state.KeepRunning())
    {
        bytes = TextOf(RapidJsonIoUtil::RenderPrettyJson(document)).size();
    }
    CountBytes(state, bytes);
}

void RenderIndexScriptText(benchmark::State& state)
{
    const rapidjson::Document& document = AllModules<IndexCombiner>().combiner.combinedDocument;
    std::size_t bytes = 0;
    while (state.KeepRunning())
    {
        bytes = TextOf(RenderIndexScript(document)).size();
    }
    CountBytes(state, bytes);
}

void RenderTocScriptText(benchmark::State& state)
{
    const TocCombiner& combiner = AllModules<TocCombiner>().combiner;
    std::size_t bytes = 0;
    while (state.KeepRunning())
    {
        bytes = TextOf(combiner.RenderScript(combiner.combinedDocument).value()).size();
    }
    CountBytes(state, bytes);
}

void Prefix(benchmark::State& state)
{
    const std::string from = "/home/builder/product/documentation/en/module-one/ScriptReference";
    const std::string to = "/home/builder/product/documentation/en/module-two/ScriptReference/";
    while (state.KeepRunning())
    {
        benchmark::DoNotOptimize(RelativePrefix(from, to));
    }
}

// NOLINTBEGIN(cert-err58-cpp,cppcoreguidelines-owning-memory): the library's own way of registering
BENCHMARK_TEMPLATE(Parse, IndexCombiner);
BENCHMARK_TEMPLATE(Parse, TocCombiner);
BENCHMARK_TEMPLATE(Validate, IndexCombiner);
BENCHMARK_TEMPLATE(Validate, TocCombiner);
BENCHMARK_TEMPLATE(Tag, IndexCombiner);
BENCHMARK_TEMPLATE(Tag, TocCombiner);
BENCHMARK_TEMPLATE(Merge, IndexCombiner);
BENCHMARK_TEMPLATE(Merge, TocCombiner);
BENCHMARK_TEMPLATE(RenderJson, IndexCombiner);
BENCHMARK_TEMPLATE(RenderJson, TocCombiner);
BENCHMARK(RenderIndexScriptText);
BENCHMARK(RenderTocScriptText);
BENCHMARK(Prefix);
// NOLINTEND(cert-err58-cpp,cppcoreguidelines-owning-memory)

} // namespace

int main(int argc, char* argv[])
{
    PrepareHeap();
    benchmark::Initialize(&argc, argv);
    if (benchmark::ReportUnrecognizedArguments(argc, argv))
    {
        return 1;
    }
    benchmark::RunSpecifiedBenchmarks();
    benchmark::Shutdown();
    return 0;
}
