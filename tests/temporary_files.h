#pragma once

#include <cstdlib>
#include <fstream>
#include <iterator>
#include <string>

#include <boost/filesystem.hpp>
#include <gtest/gtest.h>

// Gives a test that touches the disk a directory of its own, which is also the process's temporary directory during the
// test: whatever is left there was left by the library.
class TemporaryFiles : public testing::Test {
  protected:
    void SetUp() override {
        namespace fs = boost::filesystem;
        root_ = fs::temp_directory_path() / fs::unique_path("dpxlsx-test-%%%%-%%%%");
        fs::create_directories(temporary());
        fs::create_directories(files());
        if (const char* before = std::getenv("TMPDIR")) before_ = before;
        ::setenv("TMPDIR", temporary().c_str(), 1);
        workingDirectory_ = fs::current_path();
    }

    void TearDown() override {
        namespace fs = boost::filesystem;
        EXPECT_TRUE(fs::is_empty(temporary())) << "something was left in " << temporary();
        boost::system::error_code gone;
        EXPECT_EQ(fs::current_path(gone), workingDirectory_);
        fs::current_path(workingDirectory_);  // for the next test, whatever became of this one
        before_.empty() ? ::unsetenv("TMPDIR") : ::setenv("TMPDIR", before_.c_str(), 1);
        fs::remove_all(root_);
    }

    boost::filesystem::path temporary() const { return root_ / "tmp"; }
    boost::filesystem::path files() const { return root_ / "files"; }
    const boost::filesystem::path& workingDirectory() const { return workingDirectory_; }
    std::string file(const std::string& name) const { return (files() / name).string(); }

    std::string write(const std::string& name, const std::string& content) const {
        const auto path = files() / name;
        boost::filesystem::create_directories(path.parent_path());
        std::ofstream(path.string(), std::ios::binary) << content;
        return path.string();
    }
    std::string content(const std::string& name) const {
        std::ifstream stream(file(name), std::ios::binary);
        return {std::istreambuf_iterator<char>(stream), {}};
    }

  private:
    boost::filesystem::path root_;
    boost::filesystem::path workingDirectory_;
    std::string before_;
};
