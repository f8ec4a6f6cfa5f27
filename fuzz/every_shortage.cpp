// every_shortage: opens a small workbook and loads its columns while one allocation fails, then
// while that one and all later ones fail, for every allocation in turn, including those of the
// libraries below; and with every number of descriptors from none to enough. Each time it must end
// with a result or an exception that hosts know and leave nothing behind, and the same provider
// must then open the workbook.

#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <map>
#include <new>
#include <string>
#include <sys/resource.h>

#include <boost/filesystem.hpp>
#include <libxml/parser.h>

#include "dpxlsx/model/host/entry_points.h"
#include "dpxlsx/model/host/i_column.h"
#include "dpxlsx/model/host/reference.h"
#include "dpxlsx/readers/xml/xml_reader.h"
#include "fuzz/checks.h"
#include "fuzz/host.h"
#include "testkit/package_builder.h"
#include "testkit/workspace.h"

namespace {

long allocationsLeft = -1;  // until one fails; -1 when none is to fail
bool lasting = false;       // all later ones fail too

bool failsNow() {
    if (allocationsLeft < 0) return false;
    if (allocationsLeft > 0) {
        --allocationsLeft;
        return false;
    }
    if (!lasting) allocationsLeft = -1;
    return true;
}

}  // namespace

#ifdef __SANITIZE_ADDRESS__
// The sanitizer's allocator stays in place for the C libraries: only C++ and libxml2 fail.
[[gnu::noinline]] void* operator new(std::size_t size) {
    if (void* memory = failsNow() ? nullptr : std::malloc(size)) return memory;
    throw std::bad_alloc();
}
[[gnu::noinline]] void* operator new(std::size_t size, const std::nothrow_t&) noexcept {
    return failsNow() ? nullptr : std::malloc(size);
}
[[gnu::noinline]] void operator delete(void* memory) noexcept { std::free(memory); }
[[gnu::noinline]] void operator delete(void* memory, std::size_t) noexcept { std::free(memory); }
const int xmlFails = xmlMemSetup(
    std::free, [](std::size_t size) { return failsNow() ? nullptr : std::malloc(size); },
    [](void* memory, std::size_t size) {
        return failsNow() ? nullptr : std::realloc(memory, size);
    },
    [](const char* text) { return failsNow() ? nullptr : ::strdup(text); });
#else
extern "C" {
void* __libc_malloc(std::size_t);
void* __libc_calloc(std::size_t, std::size_t);
void* __libc_realloc(void*, std::size_t);
void* malloc(std::size_t size) { return failsNow() ? nullptr : __libc_malloc(size); }
void* calloc(std::size_t count, std::size_t size) {
    return failsNow() ? nullptr : __libc_calloc(count, size);
}
void* realloc(void* memory, std::size_t size) {
    return failsNow() ? nullptr : __libc_realloc(memory, size);
}
}
#endif

namespace {

constexpr int kNoMemory = 1;
constexpr int kFileSystem = 2;

int rules = 0;  // by which the workbook is read

std::string makeBook() {
    const std::string path = fuzz::ownFiles() + "/book.xlsx";
    testkit::PackageBuilder::small().write(path);
    return path;
}

// The result code, or the exception's code.
long open(dp::IDataProvider& provider, const std::string& path) {
    try {
        return provider.OpenFile(path.c_str(), dp::IDataProvider::FileAccess::Read);
    } catch (const CmXmlException& e) {
        return e.code();
    } catch (const boost::filesystem::filesystem_error&) {
        return kFileSystem;
    } catch (const std::bad_alloc&) {
        return kNoMemory;
    }
}

void loadColumns(const dp::IVariableFinder& finder) {
    for (int key = 1; key <= 5; ++key) {
        try {
            dp::IColumn* column = nullptr;
            if (finder.FindColumn(key, &column, false)) dp::Reference<dp::IColumn>{column};
        } catch (const std::bad_alloc&) {
        }
    }
}

dp::IDataProvider* newProvider() {
    dp::IDataProvider* created = nullptr;
    fuzz::require(dp::CreateDataProvider("xlsx", &created) == 0, "no provider");
    fuzz::require(dp::SetReadingRules(created, rules) == 0, "no rules");
    return created;
}

void recover(dp::IDataProvider& provider, const std::string& path) {
    provider.CloseFile();
    provider.ClearWorksheets();
    fuzz::require(open(provider, path) == 0, "the workbook does not open afterwards");
    fuzz::takeEverything(provider);
}

// The result while the allocation after `count` fails; `failed` says whether one did.
long openAtAllocation(const std::string& path, long count, bool& failed) {
    const dp::Reference provider(newProvider());
    allocationsLeft = count;
    const long result = open(*provider, path);
    loadColumns(*provider->GetVariableFinder());
    failed = allocationsLeft < 0 || (lasting && allocationsLeft == 0);
    allocationsLeft = -1;
    recover(*provider, path);
    return result;
}

long openWithDescriptors(const std::string& path, rlim_t most) {
    const dp::Reference provider(newProvider());
    rlimit before{};
    ::getrlimit(RLIMIT_NOFILE, &before);
    const rlimit less{most, before.rlim_max};
    ::setrlimit(RLIMIT_NOFILE, &less);
    const long result = open(*provider, path);
    ::setrlimit(RLIMIT_NOFILE, &before);
    recover(*provider, path);
    return result;
}

using Results = std::map<long, int>;

void print(const char* title, const Results& results) {
    std::printf("%s\n", title);
    for (const auto& [result, count] : results) std::printf("%4ld: %d\n", result, count);
}

Results failAllocations(const std::string& path) {
    Results results;
    bool failed = true;
    for (long count = 0; failed; ++count)
        fuzz::leavingNothing([&] { ++results[openAtAllocation(path, count, failed)]; });
    return results;
}

[[maybe_unused]] Results lackDescriptors(const std::string& path) {
    Results results;
    for (rlim_t most = 0; !results.contains(0); ++most)
        fuzz::leavingNothing([&] { ++results[openWithDescriptors(path, most)]; });
    return results;
}

}  // namespace

int main() {
    const std::string path = makeBook();
    for (rules = 0; rules <= 1; ++rules) {
        std::printf("by the rules %d\n", rules);
        lasting = false;
        print("one allocation", failAllocations(path));
        lasting = true;
        print("all allocations from one on", failAllocations(path));
#ifndef __SANITIZE_ADDRESS__  // the sanitizers need descriptors of their own
        print("descriptors", lackDescriptors(path));
#endif
    }
    return 0;
}
