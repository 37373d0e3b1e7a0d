// A folder for the files of a test. It goes with everything in it.
#pragma once

#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <string>

class Temporary_Folder
{
public:
    Temporary_Folder() : folder(make()) {}
    Temporary_Folder(const Temporary_Folder&) = delete;
    Temporary_Folder& operator=(const Temporary_Folder&) = delete;
    ~Temporary_Folder() { std::filesystem::remove_all(folder); }

    std::string path(const std::string& name) const { return folder / name; }

    // Writes a file; its path.
    std::string file(const std::string& name, const std::string& content) const
    {
        std::ofstream(path(name), std::ios::binary) << content;
        return path(name);
    }

    // What a file holds; nothing when there is none.
    static std::string content(const std::string& path)
    {
        std::ifstream stream(path, std::ios::binary);
        return {std::istreambuf_iterator<char>(stream), {}};
    }

    const std::filesystem::path folder;

private:
    static std::filesystem::path make()
    {
        std::string name = std::filesystem::temp_directory_path() / "zmlr_test.XXXXXX";
        return ::mkdtemp(name.data()) ? name : "";
    }
};
