// Feeds files to a fuzz target where the compiler brings no fuzzer: kept findings and seeds become tests of
// every build. Arguments are files and folders.

#include "FuzzTarget.h"

#include <algorithm>
#include <filesystem>
#include <fstream>
#include <iostream>
#include <iterator>
#include <string>
#include <vector>

namespace {

std::vector<std::filesystem::path> filesIn(const std::vector<std::string>& arguments)
{
    std::vector<std::filesystem::path> files;
    for (const std::string& argument : arguments) {
        if (!std::filesystem::is_directory(argument)) {
            files.emplace_back(argument);
            continue;
        }
        for (const auto& entry : std::filesystem::directory_iterator(argument))
            files.push_back(entry.path());
    }
    std::sort(files.begin(), files.end());
    return files;
}

void feed(const std::filesystem::path& file)
{
    std::ifstream stream(file, std::ios::binary);
    const std::string content{std::istreambuf_iterator<char>(stream), std::istreambuf_iterator<char>()};
    if (!stream)
        throw std::runtime_error("cannot be read");
    LLVMFuzzerTestOneInput(reinterpret_cast<const std::uint8_t*>(content.data()), content.size());
}

} // namespace

int main(int argc, char** argv)
{
    const std::vector<std::filesystem::path> files = filesIn({argv + 1, argv + argc});
    if (files.empty()) {
        std::cerr << "expected files or folders with files\n";
        return 2;
    }
    for (const std::filesystem::path& file : files) {
        std::cout << file.string() << std::endl; // seen even if the target crashes
        try {
            feed(file);
        } catch (const std::exception& error) {
            std::cerr << file.string() << ": " << error.what() << '\n';
            return 1;
        }
    }
    std::cout << files.size() << " inputs\n";
    return 0;
}
