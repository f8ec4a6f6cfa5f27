#pragma once

#include <string>

#include <boost/filesystem.hpp>

#include "testkit/process_settings.h"

namespace testkit {

// Writes a file, replacing it, and the directories above it; throws when that fails.
void writeFile(const std::string& path, const std::string& content);

// Two directories of a program that touches the disk, removed in the end: one for its own files,
// the other is meanwhile the process's temporary directory, where only the library leaves anything.
class Workspace {
  public:
    enum class Place { Disk, Memory };  // a file system in memory, if there is one

    explicit Workspace(Place place = Place::Disk);
    ~Workspace();
    Workspace(const Workspace&) = delete;
    Workspace& operator=(const Workspace&) = delete;

    boost::filesystem::path files() const { return root_ / "files"; }
    boost::filesystem::path temporary() const { return root_ / "tmp"; }
    std::string file(const std::string& name) const { return (files() / name).string(); }
    // Writes one of the files and returns its path.
    std::string write(const std::string& name, const std::string& content) const;

  private:
    boost::filesystem::path root_;
    EnvironmentVariable variable_;
};

}  // namespace testkit
