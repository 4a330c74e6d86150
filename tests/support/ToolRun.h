#pragma once

#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <sstream>
#include <string>
#include <sys/wait.h>
#include <unistd.h>

/// The bytes of a file.
inline std::string contentOf(const std::filesystem::path& path)
{
    std::ostringstream content;
    content << std::ifstream(path, std::ios::binary).rdbuf();
    return content.str();
}

/// A folder that is there as long as this object.
struct TemporaryFolder {
    explicit TemporaryFolder(const char* name)
        : path(std::filesystem::temp_directory_path() / (std::string(name) + '-' + std::to_string(getpid())))
    {
        std::filesystem::create_directory(path);
    }
    ~TemporaryFolder() { std::filesystem::remove_all(path); }

    /// The path of what has that name in it.
    std::string operator/(const std::string& name) const { return path / name; }
    std::string content(const std::string& name) const { return contentOf(path / name); }
    /// Writes a file, with the folders that its name needs. @return its path.
    std::string write(const std::string& name, const std::string& content, int mode = 0644) const
    {
        const std::filesystem::path file = path / name;
        std::filesystem::create_directories(file.parent_path());
        std::ofstream(file, std::ios::binary) << content;
        std::filesystem::permissions(file, std::filesystem::perms(mode));
        return file;
    }

    const std::filesystem::path path;
};

/// What a run of a program gave.
struct ToolRun {
    /// `arguments` is shell text, and may redirect the output; the program runs in `folder`.
    ToolRun(const char* program, const std::string& arguments, const TemporaryFolder& folder)
    {
        const std::string line =
            "cd '" + folder.path.string() + "' && ('" + program + "' " + arguments + ") >out 2>err";
        status = WEXITSTATUS(std::system(line.c_str()));
        out = contentOf(folder.path / "out");
        err = contentOf(folder.path / "err");
    }

    int status;
    std::string out;
    std::string err;
};
