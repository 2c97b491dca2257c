#include "Tools/DocTools/VantorPagemeld/ModuleDiscovery.h"

#include "tests/support/NeutralText.h"
#include "tests/support/TemporaryFolder.h"
#include "tests/support/WholeFile.h"

#include <gtest/gtest.h>

#include <filesystem>

#include <sys/stat.h>

TEST(ModuleDiscovery, WalksInByteOrderAndStopsAtModules)
{
    const TemporaryFolder folder;
    for (const char* docdata :
         {"b/Manual/docdata", "a/Manual/docdata", "Zeta/Manual/docdata", "x/Manual/docdata",
          "x/y/Manual/docdata", "deep/er/m-1/Manual/docdata", "deep/er/m/Manual/docdata",
          "deep-er/Manual/docdata", ".hidden/Manual/docdata", "file/n/Manual/docdata",
          "scripts/ScriptReference/docdata", "Manual/docdata", "linked/Manual"})
    {
        std::filesystem::create_directories(folder / docdata);
    }
    WriteWholeFile(folder / "file/Manual/docdata", "");
    WriteWholeFile(folder / "regular", "");
    std::filesystem::create_directories(folder / "socket/Manual");
    ASSERT_EQ(0, ::mknod((folder / "socket/Manual/docdata").c_str(), S_IFSOCK | 0600, 0));
    std::filesystem::create_directory_symlink(folder / "a", folder / "link");
    std::filesystem::create_directory_symlink(folder / "x/y", folder / "scripts/link");
    std::filesystem::create_directory_symlink(folder / "a", folder / "linked/Manual/docdata");

    std::list<std::string> found = {"kept"};
    GetPathsOfDocs(folder / "", found);
    GetPathsOfDocs(folder / "missing", found);
    GetPathsOfDocs(folder / "regular", found);
    std::string text;
    for (const std::string& path : found)
    {
        text += ReplaceAll(path, folder.Path(), "@") + "\n";
    }
    // The directory itself is no candidate, though it has a Manual/docdata; a linked docdata counts, and a
    // socket, which has the directory bit.
    EXPECT_EQ("kept\n@//Zeta\n@//a\n@//b\n@//deep/er/m\n@//deep/er/m-1\n@//deep-er\n@//file/n\n@//linked\n"
              "@//socket\n@//x\n",
              text);
}
