#include "Tools/DocTools/VantorPagemeld/System/Diagnostics.h"

#include <gtest/gtest.h>

#include <string>

#include <sys/socket.h>
#include <unistd.h>

TEST(Messages, EachIsOneWrite)
{
    int ends[2] = {};
    ASSERT_EQ(0, ::socketpair(AF_UNIX, SOCK_DGRAM, 0, ends)); // preserves the boundaries of writes
    const int standardError = ::dup(STDERR_FILENO);
    ::dup2(ends[1], STDERR_FILENO);
    const std::string longName(20'000, 'n');
    constexpr Diagnostics kDiagnostics("source");
    kDiagnostics.Warning(47, "Unable to read %s\n", longName.c_str());
    kDiagnostics.Error(200, "failed\n");
    ReportProgress("Verifying %s\n", longName.c_str());
    ::dup2(standardError, STDERR_FILENO);
    ::close(standardError);
    ::close(ends[1]);

    for (const std::string& message :
         {"WARNING: source:47 Unable to read " + longName + "\n", std::string("ERROR: source:200 failed\n"),
          "Verifying " + longName + "\n"})
    {
        std::string received(100'000, '\0');
        received.resize(
            static_cast<std::size_t>(::recv(ends[0], received.data(), received.size(), MSG_DONTWAIT)));
        EXPECT_EQ(message, received);
    }
    ::close(ends[0]);
}
