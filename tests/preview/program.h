// Tests that run programs in a directory of their own.
#pragma once

#include <gtest/gtest.h>
#include <unistd.h>

#include <cstdio>
#include <filesystem>
#include <string>

class Program : public testing::Test {
protected:
    void SetUp() override {
        std::filesystem::create_directories(directory_ / "work");
        std::filesystem::current_path(directory_ / "work");
    }
    void TearDown() override {
        std::filesystem::current_path("/");
        std::filesystem::remove_all(directory_);
    }

    // Returns the output of a shell command and, as a last line, its exit code.
    static std::string run(const std::string& command) {
        std::FILE* const shell = popen(("exec 2>&1; timeout 60 " + command + "; echo $?").c_str(), "r");
        std::string output;
        for (int c; (c = std::fgetc(shell)) != EOF;) output += static_cast<char>(c);
        pclose(shell);
        return output;
    }
    static std::string preview(const std::string& arguments, const std::string& environment = "") {
        return run("env " + environment + " '" TIDEMARK_PREVIEW_PATH "' " + arguments);
    }
    // Whether the program draws what it is asked for, and says so in one line.
    static testing::AssertionResult draws(const std::string& arguments) {
        const std::string output = preview(arguments);
        const bool isLine = output.starts_with("Drew ") && output.find('\n') == output.size() - 3;
        return isLine && output.ends_with("\n0\n") ? testing::AssertionSuccess()
                                                   : testing::AssertionFailure() << output;
    }

private:
    const std::filesystem::path directory_ = testing::TempDir() + "preview-" + std::to_string(getpid());
};
