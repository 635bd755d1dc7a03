// The formats of the trace lines, for any texts.

#include "Trace.h"

#include <cstdio>
#include <iterator>
#include <string>

#include <gtest/gtest.h>
#include <rapidcheck/gtest.h>

namespace TraceTests {

using Tavro::MessageType;
using Tavro::trace;
using Tavro::tracepara;

// What administrators' log filters know are the texts that printf makes of these formats.
RC_GTEST_PROP(TraceLines, areTextsAsPrintfFormatsThem,
              (const std::string& text, const std::string& file, unsigned int line))
{
    static constexpr const char* wordings[][2] = {
        {"ENTERING", "in"}, {"EXITING", "in"}, {"METHOD", "was invoked in"}};
    const auto number = static_cast<int>(line);
    // Short and long ones, so that some are cut in the middle.
    const std::string parameters(*rc::gen::inRange<std::size_t>(0, 600), 'p');
    char expected[512];
    for (unsigned int type = 0; type < std::size(wordings); ++type) {
        std::snprintf(expected, sizeof expected, "%s: %s() %s %s [Line: %d],Parameters List: %s",
                      wordings[type][0], text.c_str(), wordings[type][1], file.c_str(), number,
                      parameters.c_str());
        RC_ASSERT(std::string(tracepara(text.c_str(), file.c_str(), line, parameters.c_str(),
                                        static_cast<MessageType>(type))) == expected);
    }
    std::snprintf(expected, sizeof expected, "MESSAGE [File: %s, Line: %d]: %s,Parameters List: %s",
                  file.c_str(), number, text.c_str(), parameters.c_str());
    RC_ASSERT(std::string(tracepara(text.c_str(), file.c_str(), line, parameters.c_str(),
                                    MessageType::Message)) == expected);
    std::snprintf(expected, sizeof expected, "MESSAGE [File: %s, Line: %d]: %s", file.c_str(), number,
                  parameters.c_str());
    RC_ASSERT(std::string(trace(parameters.c_str(), file.c_str(), line, MessageType::Message)) == expected);
}

} // namespace TraceTests
