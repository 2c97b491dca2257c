#include "Tools/DocTools/VantorPagemeld/Merge/ArrayRecycler.h"

#include "tests/support/ParsedJson.h"

#include <gtest/gtest.h>

TEST(ArrayRecycler, ListsReuseTheStorageOfOthers)
{
    rapidjson::Document lists =
        ParsedJson("[[1,2,3,4],[5,6,7,8],[9],[10,11],[12,13],[14,15],[16,17,18],[19,20],[21]]");
    const struct
    {
        unsigned list;
        unsigned input;
        bool takesNewStorage;
    } steps[] = {
        {0, 1, true},  // leaves storage for two lists of four
        {2, 3, false}, // into that of the list that grew
        {4, 5, false}, // and into that of the list that was emptied
        {6, 7, true},  // five elements, for which no storage was left
        {6, 8, false}, // in place: it was made large enough for eight
        {2, 4, true},  // leaves what it took over
        {2, 6, true},
    };
    ArrayRecycler recycler;
    for (const auto& step : steps)
    {
        const std::size_t before = lists.GetAllocator().Size();
        recycler.MoveElements(lists[step.list], lists[step.input], lists.GetAllocator());
        EXPECT_EQ(step.takesNewStorage, lists.GetAllocator().Size() > before)
            << step.input << " into " << step.list;
    }
    EXPECT_EQ(
        "[[1,2,3,4,5,6,7,8],null,[9,10,11,12,13,14,15,16,17,18,19,20,21],null,null,null,null,null,null]",
        RapidJsonIoUtil::OutputJsonValueToString(lists));
}
