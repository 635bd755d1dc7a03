/// \file
/// The instrumentation library's lines in the log.
#ifndef TAVRO_ERRORLINE_H
#define TAVRO_ERRORLINE_H

#include <string>

namespace Tavro {

/// Where in the source code a line is logged.
struct CodePlace
{
    const char* function;
    const char* file;
    int line;
};

/// Logs an error under the library's category.
void logError(const CodePlace& place, const std::string& text);

} // namespace Tavro

#endif
