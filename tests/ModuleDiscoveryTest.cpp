#include "Tools/DocTools/VantorPagemeld/ModuleDiscovery.h"

#include "tests/support/Files.h"
#include "tests/support/Placeholders.h"
#include "tests/support/TemporaryDirectory.h"

#include <gtest/gtest.h>

#include <filesystem>

#include <sys/stat.h>

TEST(ModuleDiscovery, WalksInByteOrderAndStopsAtModules)
{
    const TemporaryDirectory directory;
    for (const char* docdata :
         {"b/Manual/docdata", "a/Manual/docdata", "Zeta/Manual/docdata", "x/Manual/docdata",
          "x/y/Manual/docdata", "deep/er/m-1/Manual/docdata", "deep/er/m/Manual/docdata",
          "deep-er/Manual/docdata", ".hidden/Manual/docdata", "file/n/Manual/docdata",
          "scripts/ScriptReference/docdata", "Manual/docdata", "linked/Manual"})
    {
        std::filesystem::create_directories(directory / docdata);
    }
    WriteFile(directory / "file/Manual/docdata", "");
    WriteFile(directory / "regular", "");
    std::filesystem::create_directories(directory / "socket/Manual");
    ASSERT_EQ(0, ::mknod((directory / "socket/Manual/docdata").c_str(), S_IFSOCK | 0600, 0));
    std::filesystem::create_directory_symlink(directory / "a", directory / "link");
    std::filesystem::create_directory_symlink(directory / "x/y", directory / "scripts/link");
    std::filesystem::create_directory_symlink(directory / "a", directory / "linked/Manual/docdata");

    std::list<std::string> found = {"kept"};
    GetPathsOfDocs(directory / "", found);
    GetPathsOfDocs(directory / "missing", found);
    GetPathsOfDocs(directory / "regular", found);
    std::string text;
    for (const std::string& path : found)
    {
        text += ReplaceAll(path, directory.Path(), "@") + "\n";
    }
    // The directory itself is not a candidate, though it has a Manual/docdata; a linked docdata counts, and a
    // socket, which has the directory bit.
    EXPECT_EQ("kept\n@//Zeta\n@//a\n@//b\n@//deep/er/m\n@//deep/er/m-1\n@//deep-er\n@//file/n\n@//linked\n"
              "@//socket\n@//x\n",
              text);
}
