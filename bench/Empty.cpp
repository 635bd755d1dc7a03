// A C++ library with nothing in it but what the language's run time makes it load.

#include <string>

const std::string
    someText("made when the library is loaded, like the logger categories of the provider library");
