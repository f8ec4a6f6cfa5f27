#pragma once

#include <functional>
#include <string>

namespace fuzz {

// Ends the process with what is wrong; the fuzzer then keeps the input.
[[noreturn]] void fail(const std::string& what);
inline void require(bool holds, const char* what) {
    if (!holds) fail(what);
}

// A directory for the files of a target, in memory where there is such a file system. The temporary
// and the working directory of the process lie elsewhere. It goes with the process.
const std::string& ownFiles();

// Writes a file of the target, replacing it.
void writeFile(const std::string& path, const std::string& content);

// Runs `work` and checks that it leaves the process as it was: working directory, umask, locale,
// signal handlers, libxml2's state and handlers, and the lowest free descriptor; that the temporary
// and the working directory are empty; and that nothing was printed. The last needs the fuzzer's
// -close_fd_mask=3, by which its own messages take another road.
void leavingNothing(const std::function<void()>& work);

}  // namespace fuzz
