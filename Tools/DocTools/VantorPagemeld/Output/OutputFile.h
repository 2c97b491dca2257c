#pragma once

#include "Tools/DocTools/VantorPagemeld/Output/ScopedFile.h"

/// A file that is either written whole or removed.
class OutputFile
{
public:
    /// Creates or truncates the file. path must outlive the object.
    explicit OutputFile(const char* path);

    /// Removes the file, unless Finish kept it.
    ~OutputFile();

    OutputFile(const OutputFile&) = delete;
    OutputFile& operator=(const OutputFile&) = delete;

    [[nodiscard]] bool IsOpen() const { return m_file != nullptr; }

    /// The stream to write to; null when the open failed.
    [[nodiscard]] std::FILE* Stream() const { return m_file.get(); }

    /// Closes the file, and keeps it when written is true and every byte reached it.
    ///
    /// Errors that the buffer holds back are asked for by a flush. The result of the close itself is not
    /// examined. Returns whether the file was kept. Called once, on an open file.
    bool Finish(bool written);

private:
    const char* m_path;
    ScopedFile m_file;
};
