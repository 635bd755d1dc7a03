/// \file
#ifndef CIMHOST_SERVE_PAGE_H
#define CIMHOST_SERVE_PAGE_H

#include <functional>
#include <string>

namespace cimhost::serve {

/// What is answered besides CIM: GET of one target.
struct Page
{
    std::string target; ///< such as /metrics
    std::string type;   ///< of the header Content-Type
    /// Called for each request, also on several threads at once. Empty: there is no such page.
    std::function<std::string()> text;
};

} // namespace cimhost::serve

#endif
