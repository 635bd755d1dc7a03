#include "cli/metrics/Exposition.h"

#include "cim/Utf8.h"

namespace cimhost::cli {

namespace {

constexpr char32_t replacementCharacter = 0xFFFD;

std::string escapedValue(std::string_view value)
{
    std::string text;
    for (const char byte : validUtf8(value)) {
        if (byte == '\n')
            text += "\\n";
        else if (byte == '\\' || byte == '"')
            text += std::string("\\") + byte;
        else
            text += byte;
    }
    return text;
}

std::string textOfLabels(const std::vector<Label>& labels)
{
    std::string text;
    for (const Label& label : labels)
        text +=
            (text.empty() ? "{" : ",") + std::string(label.name) + "=\"" + escapedValue(label.value) + '"';
    return text.empty() ? text : text + '}';
}

} // namespace

void Exposition::begin(std::string_view name, std::string_view help)
{
    name_ = name;
    text_ += "# HELP " + std::string(name) + ' ' + std::string(help) + "\n# TYPE " + std::string(name) +
             " gauge\n";
}

void Exposition::gauge(const std::vector<Label>& labels, std::string_view value)
{
    text_ += std::string(name_) + textOfLabels(labels) + ' ' + std::string(value) + '\n';
}

std::string validUtf8(std::string_view text)
{
    std::string result;
    while (!text.empty())
        cim::appendCharacter(result, cim::takeCharacter(text).value_or(replacementCharacter));
    return result;
}

} // namespace cimhost::cli
