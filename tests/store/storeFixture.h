#pragma once

#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <gtest/gtest.h>
#include <iterator>
#include <string>
#include <string_view>

namespace Project
{

/// Tests with a preferences directory of their own, which is gone afterwards.
class storeTest : public ::testing::Test
{
protected:
    storeTest()
    {
        std::string name = (std::filesystem::temp_directory_path() / "storeTest.XXXXXX").string();
        EXPECT_NE(::mkdtemp(name.data()), nullptr);
        directory = name;
    }
    ~storeTest() override { std::filesystem::remove_all(directory); }

    void Put(const std::string &name, std::string_view bytes) const
    {
        std::ofstream(directory + "/" + name, std::ios::binary) << bytes;
    }
    std::string Get(const std::string &name) const
    {
        std::ifstream file(directory + "/" + name, std::ios::binary);
        return {std::istreambuf_iterator<char>(file), {}};
    }
    bool Exists(const std::string &name) const { return std::filesystem::exists(directory + "/" + name); }

    std::string directory;
};

} // namespace Project
