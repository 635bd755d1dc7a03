/// \file
/// Help for tests that need files.
#ifndef PLATFORM_TESTING_TEMPORARYDIRECTORY_H
#define PLATFORM_TESTING_TEMPORARYDIRECTORY_H

#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <stdexcept>
#include <string>

namespace PlatformTesting {

/// An empty directory that goes with the object and with all that is in it.
class TemporaryDirectory
{
public:
    TemporaryDirectory() : path_((std::filesystem::temp_directory_path() / "platform-test-XXXXXX").string())
    {
        if (mkdtemp(path_.data()) == nullptr)
            throw std::runtime_error("no temporary directory");
    }
    ~TemporaryDirectory() { std::filesystem::remove_all(path_); }
    TemporaryDirectory(const TemporaryDirectory&) = delete;
    TemporaryDirectory& operator=(const TemporaryDirectory&) = delete;

    [[nodiscard]] std::string path(const std::string& name) const { return path_ + '/' + name; }

    /// \return the file's path
    [[nodiscard]] std::string write(const std::string& name, const std::string& content) const
    {
        std::ofstream(path(name), std::ios::binary) << content;
        return path(name);
    }

private:
    std::string path_;
};

inline std::string contentOf(const std::string& file)
{
    std::ifstream stream(file, std::ios::binary);
    return {std::istreambuf_iterator<char>(stream), {}};
}

} // namespace PlatformTesting

#endif
