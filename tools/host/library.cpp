#include "tools/host/library.h"

#include <dlfcn.h>
#include <link.h>

#include <cstdlib>
#include <filesystem>
#include <system_error>

#include "tools/host/exit_code.h"

namespace dp::tool {

namespace {

namespace fs = std::filesystem;

constexpr const char* kLibraryName = "libdpxlsx.so.1";

std::string nextToProgram() {
    std::error_code error;
    const fs::path program = fs::read_symlink("/proc/self/exe", error);
    const fs::path library = program.parent_path().parent_path() / "lib" / kLibraryName;
    return !error && fs::exists(library, error) ? library.string() : std::string();
}

std::string wantedLibrary(const std::string& given) {
    if (!given.empty()) return given;
    const char* named = std::getenv("DPXLSX_LIBRARY");
    if (named != nullptr && *named != '\0') return named;
    const std::string found = nextToProgram();
    return found.empty() ? kLibraryName : found;
}

Failure loadFailure(const std::string& library) {
    const char* reason = dlerror();
    return {kLibraryFailure, library + ": the import library cannot be loaded (" +
                                 (reason == nullptr ? "no reason given" : reason) +
                                 "); name the right file with --library"};
}

std::string realFile(const link_map& loaded) {
    std::error_code error;
    const fs::path file = fs::canonical(loaded.l_name, error);
    return error ? loaded.l_name : file.string();
}

template <class Function>
Function find(void* handle, const char* name, const std::string& library) {
    void* symbol = dlsym(handle, name);
    if (symbol == nullptr) throw loadFailure(library);
    return reinterpret_cast<Function>(symbol);
}

}  // namespace

Library::Library(const std::string& path) {
    const std::string library = wantedLibrary(path);
    handle_ = dlopen(library.c_str(), RTLD_NOW | RTLD_LOCAL);
    if (handle_ == nullptr) throw loadFailure(library);
    create_ = find<decltype(create_)>(handle_, "CreateDataProvider", library);
    type_ = find<decltype(type_)>(handle_, "GetDataProviderFiletype", library);
    rules_ = reinterpret_cast<decltype(rules_)>(symbol("SetReadingRules"));
    progress_ = reinterpret_cast<decltype(progress_)>(symbol("SetProgress"));
}

std::string Library::fileType(const std::string& book) const { return type_(book.c_str()); }

IDataProvider* Library::createProvider(const std::string& type) const {
    IDataProvider* provider = nullptr;
    const long result = create_(type.c_str(), &provider);
    if (result != 0 || provider == nullptr) {
        throw Failure(kLibraryFailure, "the import library makes no provider for the type \"" +
                                           type + "\" (result " + std::to_string(result) +
                                           "); install a library of this version");
    }
    return provider;
}

void Library::readByStandard(IDataProvider& provider) const {
    constexpr int kByStandard = 1;
    if (rules_ != nullptr && rules_(&provider, kByStandard) == 0) return;
    throw Failure(kLibraryFailure,
                  "the import library cannot read by the standard; install a library of this "
                  "version, or leave out --standard");
}

void Library::setProgress(IDataProvider& provider, int (*report)(double done, void* user),
                          void* user) const {
    if (progress_ != nullptr) progress_(&provider, report, user);
}

std::string Library::file() const {
    const link_map* loaded = nullptr;
    dlinfo(handle_, RTLD_DI_LINKMAP, &loaded);
    return realFile(*loaded);
}

std::vector<std::string> Library::loadedFiles() const {
    std::vector<std::string> files;
    const link_map* loaded = nullptr;
    dlinfo(handle_, RTLD_DI_LINKMAP, &loaded);
    while (loaded->l_prev != nullptr) loaded = loaded->l_prev;
    for (; loaded != nullptr; loaded = loaded->l_next) files.push_back(realFile(*loaded));
    return files;
}

void* Library::symbol(const char* name) const { return dlsym(handle_, name); }

}  // namespace dp::tool
