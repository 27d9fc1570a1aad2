#include "platform/host/HostEventLoop.h"

#include <QCoreApplication>
#include <cstdlib>
#include <exception>
#include <utility>

namespace kelvo {
namespace {

std::exception_ptr failure;  // what ends the program

}  // namespace

int HostEventLoop::run(int (*exec)()) {
    const int status = failure ? EXIT_FAILURE : exec();
    if (failure) std::rethrow_exception(std::exchange(failure, nullptr));
    return status;
}

void HostEventLoop::call(const std::function<void()>& callback) {
    if (failure) return;
    try {
        callback();
    } catch (...) {
        failure = std::current_exception();
        QCoreApplication::exit(EXIT_FAILURE);
    }
}

}  // namespace kelvo
