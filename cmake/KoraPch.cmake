# Headers that nearly every file reads are parsed once for each kind of target: they are half of
# what a build costs. They are those of the standard library, Qt and the test library only, so
# that an edit of ours builds no more than before. What a file uses it includes all the same: the
# debug preset builds without this.
option(KORA_PCH "Parse the headers of the libraries once for all files" ON)

# kora_pch(<kind> [QT] [TEST]): the holder of what targets of that kind share. The flags are those
# of its users, or the compiler refuses it.
function(kora_pch kind)
  cmake_parse_arguments(ARG "QT;TEST" "" "" ${ARGN})
  if(NOT KORA_PCH)
    return()
  endif()
  set(name kora_pch_${kind})
  set(source ${CMAKE_BINARY_DIR}/pch/${kind}.cpp)
  if(NOT EXISTS ${source})
    file(WRITE ${source} "// Holds the headers of ${kind}.\n")
  endif()
  add_library(${name} OBJECT ${source})
  set(headers <algorithm> <array> <cmath> <cstdint> <functional> <map> <memory> <optional> <span>
    <string> <string_view> <vector>)
  if(ARG_QT)
    target_link_libraries(${name} PRIVATE Qt6::Widgets Qt6::PrintSupport Qt6::Svg)
    target_compile_definitions(${name} PRIVATE QT_NO_KEYWORDS)
    list(APPEND headers <QApplication> <QCheckBox> <QComboBox> <QDialog> <QGridLayout> <QGroupBox>
      <QKeyEvent> <QLabel> <QLineEdit> <QListWidget> <QMenuBar> <QPointer> <QPushButton>
      <QRadioButton> <QScreen> <QVBoxLayout>)
  endif()
  if(ARG_TEST)
    target_compile_options(${name} PRIVATE -O0)
    target_link_libraries(${name} PRIVATE GTest::gtest)
    list(APPEND headers <filesystem> <gtest/gtest.h>)
    if(ARG_QT)
      target_link_libraries(${name} PRIVATE Qt6::Test)
      list(APPEND headers <QTest>)
    endif()
  endif()
  target_precompile_headers(${name} PRIVATE ${headers})
endfunction()

# kora_use_pch(<target> <kind>)
function(kora_use_pch target kind)
  if(TARGET kora_pch_${kind})
    target_precompile_headers(${target} REUSE_FROM kora_pch_${kind})
  endif()
endfunction()
