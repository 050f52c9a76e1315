# One interface target carries the compile rules; qm_room() declares a room with them.

add_library(qm_flags INTERFACE)
target_compile_features(qm_flags INTERFACE cxx_std_20)
target_compile_options(qm_flags INTERFACE
  -Wall -Wextra -Wpedantic -Wconversion -Wshadow -Werror=unused-result
  $<$<BOOL:${QM_WERROR}>:-Werror>
  # GCC 12 reports std::string concatenation as overlapping copies (GCC bug 105651).
  $<$<CXX_COMPILER_ID:GNU>:-Wno-restrict>)
if(QM_SANITIZE)
  # Instrumented code hides initialisations from GCC's analysis.
  target_compile_options(qm_flags INTERFACE -Wno-maybe-uninitialized)
  target_compile_options(qm_flags INTERFACE -fsanitize=${QM_SANITIZE} -fno-omit-frame-pointer
                                            -fno-sanitize-recover=all)
  target_link_options(qm_flags INTERFACE -fsanitize=${QM_SANITIZE})
endif()

# Optimised programs are hardened: what is read may have been made by anybody. Position independent as
# -fPIC, not -fPIE: data of the Qt libraries must not be copied into the program.
if(UNIX AND NOT QM_SANITIZE)
  target_compile_options(qm_flags INTERFACE
    $<$<CONFIG:Release>:-fPIC> $<$<CONFIG:Release>:-fstack-protector-strong>
    $<$<CONFIG:Release>:-U_FORTIFY_SOURCE> $<$<CONFIG:Release>:-D_FORTIFY_SOURCE=2>)
  target_link_options(qm_flags INTERFACE
    $<$<CONFIG:Release>:-pie> $<$<CONFIG:Release>:LINKER:-z,relro>
    $<$<CONFIG:Release>:LINKER:-z,now>)
endif()

# qm_room(<name> SOURCES a.cpp ... [DEPENDS qm::x ...] [PRIVATE_DEPENDS lib ...])
# makes the static library <name> with the alias qm::<short name>.
function(qm_room name)
  cmake_parse_arguments(ROOM "" "" "SOURCES;DEPENDS;PRIVATE_DEPENDS" ${ARGN})
  string(REGEX REPLACE "^qm_" "" short ${name})
  add_library(${name} STATIC ${ROOM_SOURCES})
  add_library(qm::${short} ALIAS ${name})
  set_target_properties(${name} PROPERTIES EXPORT_NAME ${short})
  target_compile_features(${name} PUBLIC cxx_std_20)
  target_include_directories(${name} PUBLIC $<BUILD_INTERFACE:${PROJECT_SOURCE_DIR}/src>
                                            $<INSTALL_INTERFACE:${CMAKE_INSTALL_INCLUDEDIR}>)
  target_link_libraries(${name} PUBLIC ${ROOM_DEPENDS}
                        PRIVATE $<BUILD_INTERFACE:qm_flags> ${ROOM_PRIVATE_DEPENDS})
  qm_precompile(${name} ${QM_PCH_CORE})
endfunction()

# Heavy headers, parsed once for a target. Those of the core rooms are of the standard library alone:
# the header check parses every header without them, the tidy preset every source.
set(QM_PCH_CORE <algorithm> <array> <cmath> <functional> <map> <memory> <optional> <set> <span> <string>
                <string_view> <variant> <vector>)
set(QM_PCH_TEST <gtest/gtest.h> <algorithm> <filesystem> <fstream> <functional> <map> <memory> <optional>
                <span> <string> <vector>)
set(QM_PCH_JSON <nlohmann/json.hpp> <algorithm> <functional> <map> <memory> <optional> <string> <vector>)
set(QM_PCH_QT <QAbstractTableModel> <QApplication> <QBoxLayout> <QComboBox> <QDialog> <QFormLayout>
              <QGridLayout> <QLabel> <QLineEdit> <QMainWindow> <QPainter> <QPushButton> <QString>
              <QTableView> <QTimer> <QWidget> <algorithm> <functional> <map> <memory> <optional>
              <string> <vector>)

# qm_precompile(<target> <header>...)
function(qm_precompile target)
  target_precompile_headers(${target} PRIVATE ${ARGN})
  # With precompiled headers GCC 12 reports std::string concatenation as overflowing (GCC bug 105329);
  # CMAKE_DISABLE_PRECOMPILE_HEADERS=ON brings both warnings back.
  if(NOT CMAKE_DISABLE_PRECOMPILE_HEADERS)
    target_compile_options(${target} PRIVATE
      $<$<CXX_COMPILER_ID:GNU>:-Wno-stringop-overflow -Wno-array-bounds>)
  endif()
endfunction()
