#pragma once

#include <cstdio>
#include <string>

#include <minizip/unzip.h>

namespace dp {

// A ZIP archive that is open for reading. Closes the underlying file in every case: minizip leaks
// it when memory runs out while opening.
class Archive {
  public:
    explicit Archive(const std::string& path);
    ~Archive();
    Archive(const Archive&) = delete;
    Archive& operator=(const Archive&) = delete;

    // Null for a file that is no archive, or that cannot be opened.
    unzFile handle() const { return handle_; }
    // minizip's result.
    int close();

  private:
    std::FILE* file_ = nullptr;
    unzFile handle_;
};

}  // namespace dp
