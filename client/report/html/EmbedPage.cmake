# Writes the sources of the page as arrays of a C++ file, so that the program needs no file beside it.
#   cmake -DFOLDER=... -DSCRIPTS=a.js,b.js -DOUTPUT=... -P EmbedPage.cmake
function(array_of text name out)
  string(HEX "${text}" bytes)
  string(REGEX REPLACE "([0-9a-f][0-9a-f])" "'\\\\x\\1'," bytes "${bytes}")
  set(${out} "const char ${name}[] = {\n${bytes}};\n" PARENT_SCOPE)
endfunction()

file(READ ${FOLDER}/report.html markup)
file(READ ${FOLDER}/report.css style)
string(REPLACE "," ";" scripts "${SCRIPTS}")
set(script "\"use strict\";\n")
foreach(name ${scripts})
  file(READ ${FOLDER}/${name} text)
  string(APPEND script "${text}")
endforeach()
array_of("${markup}" kMarkup markup)
array_of("${style}" kStyle style)
array_of("${script}" kScript script)
file(WRITE ${OUTPUT} "#include \"client/report/html/PageSources.h\"

namespace NORVZEL20 {

namespace {

${markup}${style}${script}
}  // namespace

std::string_view PageMarkup()
{
    return {kMarkup, sizeof kMarkup};
}

std::string_view PageStyle()
{
    return {kStyle, sizeof kStyle};
}

std::string_view PageScript()
{
    return {kScript, sizeof kScript};
}

}  // namespace NORVZEL20
")
