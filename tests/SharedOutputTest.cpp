#include "Tools/DocTools/VantorPagemeld/Write/SharedOutput.h"

#include "tests/support/Files.h"
#include "tests/support/TemporaryDirectory.h"

#include <gtest/gtest.h>

#include <cerrno>
#include <filesystem>

#include <sys/stat.h>
#include <unistd.h>

#if defined(PAGEMELD_HAVE_FILE_CLONES) && defined(PAGEMELD_WRAPS_IOCTL)
#include <linux/fs.h>

// The linker redirects ioctl to the function here (--wrap), which clones on every file system.

namespace
{

TextBuffer BufferOf(const std::string& text)
{
    TextBuffer buffer;
    AppendText(buffer, text);
    return buffer;
}

int s_refusal = EOPNOTSUPP;            ///< the error that clones end with, or 0 for clones that succeed
std::vector<std::size_t> s_cloneSizes; ///< of all clones that succeeded

int Fail(int error)
{
    errno = error;
    return -1;
}

} // namespace

extern "C" int Clone(int file, unsigned long request, int original) __asm__("__wrap_ioctl");

int Clone(int file, unsigned long request, int original)
{
    struct stat status = {};
    if (s_refusal != 0 || request != FICLONE || ::fstat(original, &status) != 0)
    {
        return Fail(s_refusal);
    }
    std::string bytes(static_cast<std::size_t>(status.st_size), '\0');
    const auto size = static_cast<ssize_t>(bytes.size());
    if (::pread(original, bytes.data(), bytes.size(), 0) != size ||
        ::pwrite(file, bytes.data(), bytes.size(), 0) != size)
    {
        return Fail(EINVAL);
    }
    s_cloneSizes.push_back(bytes.size());
    return 0;
}

TEST(SharedOutput, EveryFileIsWholeAndACloneWherePossible)
{
    constexpr std::size_t kSize = (std::size_t{1} << 20) + 1;
    const struct
    {
        const char* what;
        std::vector<const char*> names;
        int refusal;
        std::vector<std::size_t> cloneSizes;
    } cases[] = {
        {"clones", {"a", "b", "c"}, 0, {kSize, kSize}},
        {"refused", {"a", "b", "c"}, EXDEV, {}},
        {"the original is opened again, which empties it", {"a", "link to a", "b"}, 0, {0, kSize}},
        {"the first device is full", {"full", "a", "b"}, 0, {kSize}},
        {"a later device is full", {"a", "full", "b"}, 0, {kSize}},
        {"files with a head are no originals and no clones", {"a", "head", "head", "b"}, 0, {kSize}},
    };
    for (const auto& c : cases)
    {
        const TemporaryDirectory directory;
        std::filesystem::create_symlink("/dev/full", directory / "full.tmp");
        std::filesystem::create_symlink(directory / "a", directory / "link to a.tmp");
        const std::string text = "[" + std::string(kSize - 2, 'x') + "]";
        SharedOutput shared({[](const char*) {}, false}, BufferOf(text));
        s_refusal = c.refusal;
        s_cloneSizes.clear();
        for (const std::string name : c.names)
        {
            const std::string head = name == "head" ? "head" : "";
            shared.Replace(directory / name, head);
            EXPECT_EQ(name != "full", std::filesystem::exists(directory / name)) << name << ": " << c.what;
            EXPECT_TRUE(name == "full" || ReadFile(directory / name) == head + text)
                << name << ": " << c.what;
        }
        s_refusal = EOPNOTSUPP;
        EXPECT_EQ(c.cloneSizes, s_cloneSizes) << c.what;
    }
}
#endif
