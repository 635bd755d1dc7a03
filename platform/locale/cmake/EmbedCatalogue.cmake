# Writes a source file that holds the content of the English message catalogue. Run as
#   cmake -DCATALOGUE=FILE.mo -DSOURCE=FILE.cpp -P THIS

file(READ ${CATALOGUE} bytes HEX)
string(REGEX REPLACE "(..)" "\\\\x\\1" bytes "${bytes}")
string(REGEX REPLACE "(................................................................................)" "\\1\"\n    \"" bytes "${bytes}")
file(SIZE ${CATALOGUE} size)
file(
    WRITE ${SOURCE}
    "#include \"EnglishCatalogue.h\"

const std::string_view Tavro::englishCatalogue{
    \"${bytes}\", ${size}};
")
