#include "Tools/DocTools/VantorPagemeld/Output/OutputFile.h"

#include <unistd.h>

OutputFile::OutputFile(const char* path) : m_path(path), m_file(OpenForWriting(path)) {}

OutputFile::~OutputFile()
{
    if (IsOpen())
    {
        Finish(false);
    }
}

bool OutputFile::Finish(bool written)
{
    const bool complete = written && std::fflush(Stream()) == 0 && std::ferror(Stream()) == 0;
    m_file.reset();
    if (!complete)
    {
        (void)::unlink(m_path);
    }
    return complete;
}
