/// \file
/// Help for tests that need files.
#ifndef TESTING_TEMPORARYDIRECTORY_H
#define TESTING_TEMPORARYDIRECTORY_H

#include <cerrno>
#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <string>
#include <system_error>

namespace Testing {

/// An empty directory that goes with the object and with all that is in it.
class TemporaryDirectory
{
public:
    TemporaryDirectory()
    {
        std::string name = (std::filesystem::temp_directory_path() / "test-XXXXXX").string();
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
    [[nodiscard]] std::string path(const std::string& name) const { return path_ / name; }

    /// Makes a folder. \return its path
    [[nodiscard]] std::string folder(const std::string& name) const
    {
        std::filesystem::create_directories(path_ / name);
        return path(name);
    }

    /// Writes a file, with the folders above it. \return its path
    [[nodiscard]] std::string file(const std::string& name, const std::string& content) const
    {
        std::filesystem::create_directories((path_ / name).parent_path());
        std::ofstream(path_ / name, std::ios::binary) << content;
        return path(name);
    }

private:
    std::filesystem::path path_;
};

inline std::string contentOf(const std::string& file)
{
    std::ifstream stream(file, std::ios::binary);
    return {std::istreambuf_iterator<char>(stream), {}};
}

} // namespace Testing

#endif
