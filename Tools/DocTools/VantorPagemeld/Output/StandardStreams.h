#pragma once

/// Makes it safe to write messages, however the process was started. To be called before any file is opened.
///
/// Of the standard descriptors those that are closed are taken, for otherwise an output file would get one
/// and the messages in it. SIGPIPE is ignored: a standard error that nobody reads any more costs the
/// messages, not the outputs.
void SecureStandardStreams();
