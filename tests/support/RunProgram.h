#pragma once

#include <fcntl.h>
#include <sys/wait.h>
#include <unistd.h>

#include <stdexcept>
#include <string>
#include <vector>

#include "tests/support/TemporaryDirectory.h"

namespace kelvo::test {

/// What a program left behind.
struct Finished {
    int status = -1;  ///< the exit status; -1 when a signal ended it
    std::string output;
    std::string errors;
};

/// Runs a program to its end, without a terminal; `input` is the file that it finds as its standard input.
inline Finished run(const std::string& program, std::vector<std::string> arguments,
                    const std::string& input = "/dev/null") {
    const TemporaryDirectory directory;
    const std::string output = directory.file("out");
    const std::string errors = directory.file("err");
    std::vector<char*> argv{const_cast<char*>(program.c_str())};
    for (std::string& argument : arguments) argv.push_back(argument.data());
    argv.push_back(nullptr);

    const pid_t child = fork();
    if (child < 0) throw std::runtime_error("cannot fork");
    if (child == 0) {
        dup2(open(input.c_str(), O_RDONLY), STDIN_FILENO);
        dup2(open(output.c_str(), O_WRONLY | O_CREAT, 0600), STDOUT_FILENO);
        dup2(open(errors.c_str(), O_WRONLY | O_CREAT, 0600), STDERR_FILENO);
        execv(program.c_str(), argv.data());
        _exit(127);
    }
    int status = 0;
    waitpid(child, &status, 0);
    return {WIFEXITED(status) ? WEXITSTATUS(status) : -1, contentsOf(output), contentsOf(errors)};
}

}  // namespace kelvo::test
