#include "tests/support/TemporaryFolder.h"

#include <gtest/gtest.h>

#include <filesystem>
#include <stdexcept>

#include <stdlib.h> // NOLINT(modernize-deprecated-headers): mkdtemp is POSIX

TemporaryFolder::TemporaryFolder() : m_path(testing::TempDir() + "pagemeld-test-XXXXXX")
{
    if (::mkdtemp(m_path.data()) == nullptr)
    {
        throw std::runtime_error("no temporary folder at " + m_path);
    }
}

TemporaryFolder::~TemporaryFolder()
{
    std::error_code ignored;
    std::filesystem::remove_all(m_path, ignored);
}
