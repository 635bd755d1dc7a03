#include "Script.h"

#include <cctype>
#include <sstream>

namespace Fuzz {

namespace {

bool isHexadecimal(char character)
{
    return std::isxdigit(static_cast<unsigned char>(character)) != 0;
}

std::string unescaped(const std::string& word)
{
    if (word == ".")
        return "";
    std::string text;
    for (std::size_t i = 0; i < word.size(); ++i) {
        if (word[i] == '%' && i + 2 < word.size() && isHexadecimal(word[i + 1]) &&
            isHexadecimal(word[i + 2])) {
            text += static_cast<char>(std::stoi(word.substr(i + 1, 2), nullptr, 16));
            i += 2;
        } else {
            text += word[i];
        }
    }
    return text;
}

} // namespace

Step::Step(const std::string& line)
{
    std::istringstream words(line);
    words >> name_;
    for (std::string word; words >> word;)
        arguments_.push_back(word);
}

std::optional<std::string> Step::text(std::size_t position) const
{
    if (position >= arguments_.size() || arguments_[position] == "-")
        return std::nullopt;
    return unescaped(arguments_[position]);
}

unsigned int Step::number(std::size_t position) const
{
    unsigned int number = 0;
    for (const char digit : text(position).value_or("")) {
        if (std::isdigit(static_cast<unsigned char>(digit)) == 0)
            return 0;
        number = number * 10 + static_cast<unsigned int>(digit - '0');
    }
    return number;
}

std::optional<std::vector<std::string>> Step::list(std::size_t position) const
{
    if (!text(position))
        return std::nullopt;
    std::vector<std::string> items;
    std::istringstream words(arguments_[position] == "." ? "" : arguments_[position]);
    for (std::string word; std::getline(words, word, ',');)
        items.push_back(unescaped(word));
    return items;
}

std::vector<Step> stepsOf(const std::string& script)
{
    std::vector<Step> steps;
    std::istringstream lines(script);
    for (std::string line; std::getline(lines, line);)
        steps.emplace_back(line);
    return steps;
}

} // namespace Fuzz
