// Small trees, read as sysfs: whatever lies there, the walk comes to its end with sound indicators.
//
// An input is a list of pairs of texts, each ended by a null character: what to make and where, and with
// what. "f PATH" is a file with that content, "l PATH" a link to that target, "d PATH" a directory, "p PATH"
// a pipe.

#include "FuzzTarget.h"
#include "sources/NodeSource.h"
#include "testing/TemporaryDirectory.h"

#include <filesystem>
#include <fstream>
#include <optional>
#include <string_view>
#include <system_error>
#include <vector>

#include <sys/stat.h>

namespace fs = std::filesystem;

namespace {

constexpr int mostEntries = 40;

class Tree
{
public:
    Tree() { setenv("TAVRO_SYSFS_ROOT", root_.path().c_str(), 1); }

    /// Does nothing where that cannot be made, as below a file.
    void make(char what, std::string_view name, std::string_view with) const
    {
        const std::optional<fs::path> path = within(name);
        if (!path)
            return;
        std::error_code error;
        fs::create_directories(path->parent_path(), error);
        if (error || fs::exists(fs::symlink_status(*path, error)))
            return;
        if (what == 'f')
            std::ofstream(*path, std::ios::binary) << with;
        else if (what == 'l')
            fs::create_symlink(fs::path(with), *path, error);
        else if (what == 'd')
            fs::create_directories(*path, error);
        else if (what == 'p')
            (void)mkfifo(path->c_str(), 0600);
    }

private:
    /// Nothing: the path would leave the tree, by itself or through a link.
    [[nodiscard]] std::optional<fs::path> within(std::string_view name) const
    {
        fs::path path = root_.path();
        std::error_code error;
        for (const fs::path& part : fs::path(name)) {
            if (part.empty() || part == "." || part == ".." || part == "/" ||
                fs::is_symlink(fs::symlink_status(path, error)))
                return std::nullopt;
            path /= part;
        }
        if (path == root_.path())
            return std::nullopt;
        return path;
    }

    Testing::TemporaryDirectory root_;
};

std::string_view takeText(std::string_view& input)
{
    const std::size_t end = input.find('\0');
    const std::string_view text = input.substr(0, end);
    input.remove_prefix(end == std::string_view::npos ? input.size() : end + 1);
    return text;
}

void requireSound(const Tavro::Node& node)
{
    Fuzz::require(node.kind == 36, "a node is an indicator");
    Fuzz::require(!node.description.empty(), "an indicator has a description");
    Fuzz::require(node.path.rfind('/', 0) == 0, "a path begins at the root");
    Fuzz::require(node.displayText != nullptr && node.displayText->rfind("/sys/class/", 0) == 0,
                  "an indicator has its class's path");
    Fuzz::require(node.alarmState.value_or(17) <= 3, "an alarm state is one of the four");
    Fuzz::require(node.status <= 1 || (node.status >= 20 && node.status <= 22),
                  "a status is one of the five");
}

} // namespace

int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size)
{
    const std::string text = Fuzz::textOf(data, size);
    std::string_view input = text;
    const Tree tree;
    for (int entry = 0; entry < mostEntries && !input.empty(); ++entry) {
        const std::string_view place = takeText(input);
        const std::string_view with = takeText(input);
        if (place.size() > 2 && place[1] == ' ')
            tree.make(place[0], place.substr(2), with);
    }
    std::vector<Tavro::Node> nodes;
    Tavro::appendNodesOf(Tavro::nodeSources(), nodes);
    for (const Tavro::Node& node : nodes)
        requireSound(node);
    return 0;
}
