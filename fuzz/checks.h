#pragma once

#include <functional>
#include <string>

namespace fuzz {

// Reports what is wrong and aborts; the fuzzer then keeps the input.
[[noreturn]] void fail(const std::string& what);
inline void require(bool holds, const char* what) {
    if (!holds) fail(what);
}

// A directory for the files of a target, on a file system in memory if there is one. The temporary
// and the working directory of the process are other ones. Removed when the process ends.
const std::string& ownFiles();

// Runs `work` and checks that it leaves the process as it was: working directory, umask, locale,
// signal handlers, libxml2's state and handlers, and the lowest free descriptor; that the temporary
// and the working directory are empty; and that nothing was printed. The last check needs the
// fuzzer's option -close_fd_mask=3, with which its own messages do not go to the standard streams.
void leavingNothing(const std::function<void()>& work);

}  // namespace fuzz
