#pragma once

#include <cstdio>
#include <memory>
#include <string>
#include <vector>

#include "platform/values/Bytes.h"
#include "platform/values/Result.h"

namespace kelvo {

/// What the user permits an output to do.
struct OutputTerms {
    bool replace = false;                     ///< "--force": a file that is there gives way
    std::vector<std::string> beingRead = {};  ///< files that stay, by whatever name the output's path leads to them
};

/// A file that a program writes because its user asked for it. It takes shape under another name beside its place and
/// gets its own when it is whole, so that nobody meets half of one. It is for this user alone (mode 0600), replaces
/// nothing unless the user says so, and never a file that the program is reading. A device or a pipe is written to as
/// it is.
/// Moves, never copies; what has not appeared goes with its owner. Any thread, one at a time. A failure's reason names
/// the file.
class OutputFile {
public:
    /// Refuses now what could only fail later: a name that is taken, a directory that is not there. Nothing is made
    /// yet.
    static Result<OutputFile> create(std::string path, OutputTerms terms = {});

    /// Appends to the file; it need not have appeared yet.
    Result<void> write(ByteView bytes);
    /// Gives the file its name once its bytes are on the disk. Fails when the name has been taken meanwhile.
    /// Idempotent.
    Result<void> appear();

    const std::string& path() const { return _path; }
    /// Where the file takes shape, for a library that opens files by their names and leaves this one alone once it
    /// appears. A failure for a device or a pipe.
    Result<std::string> place();
    /// A stream of the caller's own that appends to the file.
    Result<std::FILE*> stream();

private:
    struct Closer {
        void operator()(std::FILE* file) const { std::fclose(file); }
    };
    struct Remover {
        void operator()(const std::string* path) const;
    };

    OutputFile(std::string path, OutputTerms terms) : _path(std::move(path)), _terms(std::move(terms)) {}
    Result<void> check() const;
    Result<void> open();
    Failure failed(int error) const;

    std::string _path;
    OutputTerms _terms;
    std::unique_ptr<const std::string, Remover> _temporary;  // the name it takes shape under; none before and after
    std::unique_ptr<std::FILE, Closer> _file;                // unbuffered; none before the first byte
};

/// Writes `bytes` to a file that appears whole.
Result<void> writeFile(const std::string& path, ByteView bytes, OutputTerms terms = {});

}  // namespace kelvo
