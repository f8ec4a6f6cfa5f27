#include "fuzz/checks.h"

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
#include "testkit/workspace.h"

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
    Surroundings()
        : files(workspace_.files().string()), temporary(workspace_.temporary().string()) {
        const fs::path directory = workspace_.files().parent_path() / "cwd";
        fs::create_directory(directory);
        fs::current_path(directory);
        xmlInitParser();
        xmlSetGenericErrorFunc(this, onXmlMessage);
        xmlSetStructuredErrorFunc(this, onXmlError);
    }

  private:
    testkit::Workspace workspace_{testkit::Workspace::Place::Memory};

  public:
    const std::string files;
    const std::string temporary;
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
