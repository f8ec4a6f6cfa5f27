#pragma once

#include <fstream>
#include <iterator>
#include <string>

#include <boost/filesystem.hpp>
#include <gtest/gtest.h>

#include "testkit/workspace.h"

// Gives a test that touches the disk a directory of its own, which is also the process's temporary directory during the
// test: whatever is left there was left by the library.
class TemporaryFiles : public testing::Test {
  protected:
    void TearDown() override {
        namespace fs = boost::filesystem;
        EXPECT_TRUE(fs::is_empty(temporary())) << "something was left in " << temporary();
        boost::system::error_code gone;
        EXPECT_EQ(fs::current_path(gone), workingDirectory_);
        fs::current_path(workingDirectory_);  // for the next test, whatever became of this one
    }

    boost::filesystem::path temporary() const { return workspace_.temporary(); }
    boost::filesystem::path files() const { return workspace_.files(); }
    const boost::filesystem::path& workingDirectory() const { return workingDirectory_; }
    std::string file(const std::string& name) const { return workspace_.file(name); }
    std::string write(const std::string& name, const std::string& content) const {
        return workspace_.write(name, content);
    }
    std::string content(const std::string& name) const {
        std::ifstream stream(file(name), std::ios::binary);
        return {std::istreambuf_iterator<char>(stream), {}};
    }

  private:
    testkit::Workspace workspace_;
    boost::filesystem::path workingDirectory_ = boost::filesystem::current_path();
};
