#pragma once

#include <string>
#include <vector>

#include <dpxlsx/model/host/entry_points.h>
#include <dpxlsx/model/host/i_data_provider.h>

namespace dp::tool {

// The import library. It stays loaded until the program ends: exceptions that it threw may still be
// alive, and unloading would lose the tables that the libraries below it keep.
class Library {
  public:
    // Loads the library at `path`. If that is empty: the one that the environment variable
    // DPXLSX_LIBRARY names, else the one in the folder lib beside the program's folder, else the
    // one that the loader finds. Throws a Failure when none can be loaded.
    explicit Library(const std::string& path);

    // The library's name for the type of the file; empty when the library does not read such files.
    std::string fileType(const std::string& book) const;
    // A provider with a reference count of 0. Throws a Failure when there is none.
    IDataProvider* createProvider(const std::string& type) const;
    // Makes the provider read by the standard. Throws a Failure when the library cannot.
    void readByStandard(IDataProvider& provider) const;
    // Lets the provider tell `report` how far it is, and be ended by its answer. Does nothing when
    // the library cannot.
    void setProgress(IDataProvider& provider, int (*report)(double done, void* user),
                     void* user) const;

    // The file that was loaded, with all links followed.
    std::string file() const;
    // The files of all libraries that are loaded now.
    std::vector<std::string> loadedFiles() const;
    // A function that the library, or one that it needs, exports; null when none does.
    template <class Function>
    Function* function(const char* name) const {
        return reinterpret_cast<Function*>(symbol(name));
    }

  private:
    void* symbol(const char* name) const;

    void* handle_;
    decltype(&CreateDataProvider) create_;
    decltype(&GetDataProviderFiletype) type_;
    decltype(&SetReadingRules) rules_;  // null when the library is too old for it
    decltype(&SetProgress) progress_;   // the same
};

}  // namespace dp::tool
