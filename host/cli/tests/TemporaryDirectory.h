/// \file
/// A folder that is gone with the test.
#ifndef CIMHOST_CLI_TESTS_TEMPORARYDIRECTORY_H
#define CIMHOST_CLI_TESTS_TEMPORARYDIRECTORY_H

#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <string>
#include <system_error>

namespace cimhost::cli {

class TemporaryDirectory
{
public:
    TemporaryDirectory()
    {
        std::string name = (std::filesystem::temp_directory_path() / "cimhost-XXXXXX").string();
        if (mkdtemp(name.data()) == nullptr)
            throw std::system_error(errno, std::generic_category(), name);
        path_ = name;
    }
    ~TemporaryDirectory()
    {
        std::error_code ignored;
        std::filesystem::remove_all(path_, ignored);
    }
    TemporaryDirectory(const TemporaryDirectory&) = delete;
    TemporaryDirectory& operator=(const TemporaryDirectory&) = delete;

    [[nodiscard]] const std::filesystem::path& path() const { return path_; }

    /// Makes a folder and returns its name.
    [[nodiscard]] std::string folder(const std::string& name) const
    {
        std::filesystem::create_directories(path_ / name);
        return (path_ / name).string();
    }

    /// Writes a file, with the folders above it, and returns its name.
    [[nodiscard]] std::string file(const std::string& name, const std::string& content) const
    {
        const std::filesystem::path file = path_ / name;
        std::filesystem::create_directories(file.parent_path());
        std::ofstream(file) << content;
        return file.string();
    }

private:
    std::filesystem::path path_;
};

} // namespace cimhost::cli

#endif
