// A folder for the files of a test. It goes with everything in it.
#pragma once

#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <string>

class Temporary_Folder
{
public:
    Temporary_Folder(const Temporary_Folder&) = delete;
    Temporary_Folder& operator=(const Temporary_Folder&) = delete;

protected:
    Temporary_Folder() = default;
    ~Temporary_Folder() { std::filesystem::remove_all(folder); }

    std::string path(const std::string& name) const { return folder / name; }

    // Writes a file; its path.
    std::string file(const std::string& name, const std::string& content) const
    {
        std::ofstream(path(name), std::ios::binary) << content;
        return path(name);
    }

    const std::filesystem::path folder = make();

private:
    static std::filesystem::path make()
    {
        std::string name = std::filesystem::temp_directory_path() / "hxal_test.XXXXXX";
        return ::mkdtemp(name.data()) ? name : "";
    }
};
