# Puts the page together and writes it as a C++ source.
#   cmake -D PAGE=report/page -D LIBRARIES="a.js;b.js" -D SCRIPTS="a.js;b.js" -D OUTPUT=PageTemplate.cpp
#         -P EmbedPage.cmake
# Scripts share one scope, in their order.

function(read_all result)
    set(text "")
    foreach(file ${ARGN})
        file(READ ${file} content)
        string(APPEND text "${content}\n")
    endforeach()
    set(${result} "${text}" PARENT_SCOPE)
endfunction()

list(TRANSFORM SCRIPTS PREPEND ${PAGE}/)
read_all(libraries ${LIBRARIES})
read_all(script ${SCRIPTS})
read_all(style ${PAGE}/page.css)
read_all(licences ${PAGE}/licences.html)
read_all(page ${PAGE}/page.html)
foreach(part libraries script style licences)
    if("${${part}}" MATCHES "</(script|style)")
        message(FATAL_ERROR "${part}: would end the element that it stands in")
    endif()
    string(REPLACE "{{${part}}}" "${${part}}" page "${page}")
endforeach()

file(WRITE ${OUTPUT} "#include \"report/PageTemplate.h\"

namespace report {

std::string_view pageTemplate() {
    return R\"orlithpage(${page})orlithpage\";
}

}  // namespace report
")
