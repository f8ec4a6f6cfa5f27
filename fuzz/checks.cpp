#include "fuzz/checks.h"

#include <fcntl.h>
#include <unistd.h>

#include <array>
#include <clocale>
#include <csignal>
#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <sys/mman.h>
#include <sys/stat.h>
#include <sys/sysmacros.h>

#include <boost/filesystem.hpp>
#include <libxml/parser.h>

#include "dpxlsx/readers/xml/silence.h"

namespace fuzz {

namespace {

namespace fs = boost::filesystem;

// Duplicated before the fuzzer closes it.
const int messages = ::dup(STDERR_FILENO);

extern "C" void onXmlMessage(void*, const char*, ...) {
    fail("libxml2 reported to the host's handler");
}
extern "C" void onXmlError(void*, dp::XmlErrorPointer) {
    fail("libxml2 reported to the host's handler");
}

// The directories of this process, and a host's handlers of libxml2.
class Surroundings {
  public:
    Surroundings() {
        const fs::path memory = "/dev/shm";
        const fs::path base =
            ::access(memory.c_str(), W_OK) == 0 ? memory : fs::temp_directory_path();
        root_ = base / fs::unique_path("dpxlsx-fuzz-%%%%-%%%%");
        for (const char* name : {"tmp", "files", "cwd"}) fs::create_directories(root_ / name);
        files = (root_ / "files").string();
        temporary = (root_ / "tmp").string();
        ::setenv("TMPDIR", temporary.c_str(), 1);
        fs::current_path(root_ / "cwd");
        xmlInitParser();
        xmlSetGenericErrorFunc(this, onXmlMessage);
        xmlSetStructuredErrorFunc(this, onXmlError);
    }
    ~Surroundings() {
        boost::system::error_code ignored;
        fs::remove_all(root_, ignored);
    }
    Surroundings(const Surroundings&) = delete;
    Surroundings& operator=(const Surroundings&) = delete;

    std::string files;
    std::string temporary;

  private:
    fs::path root_;
};

Surroundings& surroundings() {
    static Surroundings instance;
    return instance;
}

std::uintptr_t numberOf(auto pointer) { return reinterpret_cast<std::uintptr_t>(pointer); }

// State of the process whose change a host would notice.
struct ProcessState {
    std::array<char, 4096> workingDirectory{};
    mode_t mask;
    std::string locale;
    std::array<std::uintptr_t, 32> signalHandlers{};
    std::array<std::uintptr_t, 12> xml;
    int freeDescriptor;

    ProcessState()
        : mask(::umask(0)),
          locale(std::setlocale(LC_ALL, nullptr)),
          xml{numberOf(xmlGenericError),
              numberOf(xmlGenericErrorContext),
              numberOf(xmlStructuredError),
              numberOf(xmlStructuredErrorContext),
              numberOf(xmlGetExternalEntityLoader()),
              static_cast<std::uintptr_t>(xmlSubstituteEntitiesDefaultValue),
              static_cast<std::uintptr_t>(xmlLoadExtDtdDefaultValue),
              static_cast<std::uintptr_t>(xmlKeepBlanksDefaultValue),
              static_cast<std::uintptr_t>(xmlGetWarningsDefaultValue),
              static_cast<std::uintptr_t>(xmlLineNumbersDefaultValue),
              static_cast<std::uintptr_t>(xmlDoValidityCheckingDefaultValue),
              static_cast<std::uintptr_t>(xmlPedanticParserDefaultValue)},
          freeDescriptor(::dup(STDIN_FILENO)) {
        ::close(freeDescriptor);
        ::umask(mask);
        if (!::getcwd(workingDirectory.data(), workingDirectory.size()))
            fail("no working directory");
        for (int number = 1; number < static_cast<int>(signalHandlers.size()); ++number) {
            struct sigaction action {};
            ::sigaction(number, nullptr, &action);
            signalHandlers[static_cast<std::size_t>(number)] = numberOf(action.sa_handler);
        }
    }
};

void compare(const ProcessState& before, const ProcessState& after) {
    require(before.workingDirectory == after.workingDirectory, "another working directory");
    require(before.mask == after.mask, "another umask");
    require(before.locale == after.locale, "another locale");
    require(before.signalHandlers == after.signalHandlers, "another signal handler");
    require(before.xml == after.xml, "libxml2 is set otherwise");
    require(before.freeDescriptor == after.freeDescriptor, "a descriptor was left open");
}

void requireEmpty(const char* directory) {
    for (const fs::path& entry : fs::directory_iterator(directory)) fail("left: " + entry.string());
}

bool isNull(int descriptor) {
    struct stat status {};
    return ::fstat(descriptor, &status) == 0 && S_ISCHR(status.st_mode) &&
           status.st_rdev == makedev(1, 3);
}

// Redirects what is printed to memory; -1 when the streams are in use.
int takeOutput() {
    if (!isNull(STDOUT_FILENO) || !isNull(STDERR_FILENO)) return -1;
    const int taken = ::memfd_create("printed", MFD_CLOEXEC);
    ::dup2(taken, STDOUT_FILENO);
    ::dup2(taken, STDERR_FILENO);
    return taken;
}

void requireSilence(int output) {
    if (output < 0) return;
    std::fflush(nullptr);
    struct stat status {};
    if (::fstat(output, &status) == 0 && status.st_size > 0) fail("something was printed");
}

}  // namespace

void fail(const std::string& what) {
    ::dprintf(messages, "fuzz: %s\n", what.c_str());
    std::abort();
}

const std::string& ownFiles() { return surroundings().files; }

void writeFile(const std::string& path, const std::string& content) {
    const int file = ::open(path.c_str(), O_WRONLY | O_CREAT | O_TRUNC | O_CLOEXEC, 0600);
    const ssize_t size = static_cast<ssize_t>(content.size());
    require(file >= 0 && ::write(file, content.data(), content.size()) == size, "no file written");
    ::close(file);
}

void leavingNothing(const std::function<void()>& work) {
    const Surroundings& here = surroundings();
    static const int output = takeOutput();
    const ProcessState before;
    work();
    compare(before, ProcessState());
    requireEmpty(here.temporary.c_str());
    requireEmpty(before.workingDirectory.data());
    requireSilence(output);
}

}  // namespace fuzz
