#include "Tools/DocTools/VantorPagemeld/Script/RelativePrefix.h"
#include "fuzz/Property.h"

// The prefix is what its definition says, step by step and byte by byte.

namespace
{

std::size_t SplitByDefinition(const std::string& from, const std::string& to)
{
    std::size_t k = 0;
    while (k < from.size() && k < to.size() && from[k] == to[k])
    {
        ++k;
    }
    if (k < to.size() && to[k] == '/')
    {
        return k;
    }
    std::size_t split = k;
    while (split > 0)
    {
        --split;
        if (to[split] == '/')
        {
            break;
        }
    }
    return split;
}

std::string PrefixByDefinition(const std::string& from, const std::string& to)
{
    const std::size_t split = SplitByDefinition(from, to);
    std::string prefix;
    for (std::size_t i = split; i < from.size(); ++i)
    {
        prefix += from[i] == '/' ? "../" : "";
    }
    std::size_t tail = split;
    while (tail < to.size() && to[tail] == '/')
    {
        ++tail;
    }
    return prefix + to.substr(tail);
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size)
{
    const std::vector<std::string> paths = SplitInput(data, size);
    const std::string& from = paths.front();
    for (const std::string& to : {paths.back(), paths.back() + "/"})
    {
        Require(RelativePrefix(from, to) == PrefixByDefinition(from, to), "the prefix obeys its definition");
    }
    return 0;
}
