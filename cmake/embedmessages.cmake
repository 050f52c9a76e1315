# cmake -DOUTPUT=file.cpp "-DCATALOGUES=en.txt;it.txt" -P embedmessages.cmake
# Writes a source that holds the catalogue files as they are; their names become the language codes.

set(rows "")
foreach(file IN LISTS CATALOGUES)
  get_filename_component(language ${file} NAME_WE)
  file(READ ${file} text)
  string(FIND "${text}" ")qm_text\"" clash)
  if(NOT clash EQUAL -1)
    message(FATAL_ERROR "${file}: contains the mark that ends an embedded text")
  endif()
  string(APPEND rows "    {\"${language}\", R\"qm_text(${text})qm_text\"sv},\n")
endforeach()

file(WRITE ${OUTPUT} "// Made from the message catalogues by embedmessages.cmake.
#include \"qm_base/messagesources.h\"

namespace zql::lib {

namespace {

// The compiler knows the length of such a literal; counting it would exceed the steps clang allows in a constant.
using namespace std::string_view_literals;

constexpr T_MESSAGE_SOURCE kSources[] = {
${rows}};

} // namespace

std::span<const T_MESSAGE_SOURCE> MessageSources() { return kSources; }

} // namespace zql::lib
")
