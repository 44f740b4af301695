# Run as a script: writes a source with the built page's files as texts.
#   cmake -DPAGE=web/page -DOUTPUT=PageFiles.cpp -P PallaxEmbed.cmake
function(embed variable file)
    file(READ ${file} hex HEX)
    string(REGEX REPLACE "(..)" "'\\\\x\\1'," bytes "${hex}")
    string(REGEX REPLACE "(('....',)('....',)('....',)('....',)('....',)('....',)('....',)('....',))" "\\1\n" bytes "${bytes}")
    string(APPEND source "constexpr char ${variable}Bytes[] = {\n${bytes}\n};\n")
    string(APPEND views "const std::string_view ${variable}(${variable}Bytes, sizeof ${variable}Bytes);\n")
    set(source "${source}" PARENT_SCOPE)
    set(views "${views}" PARENT_SCOPE)
endfunction()
embed(kSkeleton ${PAGE}/index.html)
embed(kScript ${PAGE}/dist/page.js)
embed(kStyle ${PAGE}/dist/page.css)
file(WRITE ${OUTPUT} "// Made from web/page by cmake/PallaxEmbed.cmake.
#include \"report/PageFiles.h\"

namespace pallax::page_files {

namespace {

${source}
} // namespace

${views}
} // namespace pallax::page_files
")
