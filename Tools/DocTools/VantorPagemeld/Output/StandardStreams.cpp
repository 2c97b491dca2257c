#include "Tools/DocTools/VantorPagemeld/Output/StandardStreams.h"

#include <csignal>

#include <fcntl.h>
#include <unistd.h>

void SecureStandardStreams()
{
    // An open takes the lowest free descriptor. The root folder is always there, and can't be written to.
    int descriptor = STDIN_FILENO;
    while (descriptor >= 0 && descriptor <= STDERR_FILENO)
    {
        descriptor = ::open("/", O_RDONLY | O_DIRECTORY);
    }
    (void)::close(descriptor);
    (void)std::signal(SIGPIPE, SIG_IGN);
}
