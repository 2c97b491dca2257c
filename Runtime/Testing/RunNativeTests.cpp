#include "Runtime/Testing/RunNativeTests.h"

int RunNativeTests(const std::string& /*filter*/)
{
    return 0; // no self-tests are compiled in yet
}
