# SPDX-License-Identifier: MIT
# One place for compiler settings and for the kinds of target that the tree knows.

set(CMAKE_CXX_STANDARD 20)
set(CMAKE_CXX_STANDARD_REQUIRED ON)
set(CMAKE_CXX_EXTENSIONS OFF)
set(CMAKE_EXPORT_COMPILE_COMMANDS ON)
set(CMAKE_AUTOMOC ON)
set(CMAKE_AUTORCC ON)
set(CMAKE_OPTIMIZE_DEPENDENCIES ON)

# Everything lands side by side, so that the shared objects are found beside the program.
set(CMAKE_RUNTIME_OUTPUT_DIRECTORY ${CMAKE_BINARY_DIR}/bin)
set(CMAKE_LIBRARY_OUTPUT_DIRECTORY ${CMAKE_BINARY_DIR}/bin)
set(CMAKE_BUILD_RPATH_USE_ORIGIN ON)
set(CMAKE_INSTALL_RPATH "$ORIGIN")

find_package(Qt6 6.4 REQUIRED COMPONENTS Core Gui Widgets PrintSupport Test)
find_package(SQLite3 REQUIRED)
find_package(PostgreSQL REQUIRED)

find_program(ZELMARS_CCACHE ccache)
if(ZELMARS_CCACHE)
    set(CMAKE_CXX_COMPILER_LAUNCHER ${ZELMARS_CCACHE})
endif()
find_program(ZELMARS_MOLD mold)
if(ZELMARS_MOLD)
    add_link_options(-fuse-ld=mold)
endif()

# One position-independent code model for libraries and programs alike, so that all of them can
# share the precompiled headers.
add_compile_options(-fPIC)
if(ZELMARS_CCACHE)
    add_compile_options(-fpch-preprocess)
endif()

# What keeps a fault from becoming somebody else's code: checks of the stack, of copies into fixed
# room and of positions in containers, jumps only to where a function begins, and nothing of the
# dynamic linker's tables left to write once the program runs.
add_compile_options(-fstack-protector-strong -fstack-clash-protection)
add_compile_definitions(_GLIBCXX_ASSERTIONS)
include(CheckCXXCompilerFlag)
check_cxx_compiler_flag(-fcf-protection=full ZELMARS_CF_PROTECTION)
if(ZELMARS_CF_PROTECTION)
    add_compile_options(-fcf-protection=full)
endif()
if(NOT ZELMARS_SANITIZE)  # which checks copies itself
    add_compile_options(-U_FORTIFY_SOURCE -D_FORTIFY_SOURCE=3)
endif()
add_link_options(-Wl,-z,relro,-z,now,-z,noexecstack
                 $<$<STREQUAL:$<TARGET_PROPERTY:TYPE>,EXECUTABLE>:-pie>)

if(ZELMARS_SANITIZE)
    add_compile_options(-fsanitize=address,undefined -fno-omit-frame-pointer
                        -fno-sanitize-recover=undefined)
    add_link_options(-fsanitize=address,undefined)
endif()

# Warnings for our own sources.
add_library(zelmars_warnings INTERFACE)
target_compile_options(zelmars_warnings INTERFACE -Wall -Wextra -Wpedantic -Wconversion -Wshadow)
target_compile_definitions(zelmars_warnings INTERFACE QT_NO_CAST_TO_ASCII QT_NO_FOREACH)

# Precompiled headers: one for code without widgets, one for screens.
function(zelmars_precompiled name qt headers)
    # Written once: a fresher file would have everything built anew.
    if(NOT EXISTS ${CMAKE_BINARY_DIR}/pch/${name}.cpp)
        file(WRITE ${CMAKE_BINARY_DIR}/pch/${name}.cpp "")
    endif()
    add_library(${name} STATIC ${CMAKE_BINARY_DIR}/pch/${name}.cpp)
    target_link_libraries(${name} PRIVATE ${qt} zelmars_warnings)
    target_include_directories(${name} PRIVATE ${CMAKE_SOURCE_DIR})
    target_precompile_headers(${name} PRIVATE ${headers})
    set_target_properties(${name} PROPERTIES AUTOMOC OFF)
endfunction()
set(ZELMARS_CORE_HEADERS <QtCore/QString> <QtCore/QVariant> <QtCore/QDateTime> <QtCore/QObject>
    <QtCore/QHash> <QtCore/QList> <QtCore/QFile> <QtCore/QDir> <QtCore/QLocale> <QtCore/QPointer>
    <QtCore/QCoreApplication> <QtCore/QTimer> <functional> <memory> <optional> <vector>)
set(ZELMARS_SCREEN_HEADERS ${ZELMARS_CORE_HEADERS} <QtWidgets/QApplication> <QtWidgets/QBoxLayout>
    <QtWidgets/QComboBox> <QtWidgets/QDialog> <QtWidgets/QGridLayout> <QtWidgets/QGroupBox>
    <QtWidgets/QLabel> <QtWidgets/QLineEdit> <QtWidgets/QMainWindow> <QtWidgets/QMessageBox>
    <QtWidgets/QPushButton> <QtWidgets/QRadioButton> <QtWidgets/QTableView>
    <QtGui/QKeyEvent> <QtGui/QPainter> <QtGui/QWindow>)
zelmars_precompiled(zelmars_pch_core Qt6::Core "${ZELMARS_CORE_HEADERS}")
zelmars_precompiled(zelmars_pch_screens Qt6::Widgets "${ZELMARS_SCREEN_HEADERS}")

function(zelmars_settle target)
    target_include_directories(${target} PUBLIC ${CMAKE_SOURCE_DIR})
    target_link_libraries(${target} PRIVATE zelmars_warnings)
    if(ZELMARS_WIDGETS)
        target_link_libraries(${target} PUBLIC Qt6::Widgets)
        target_precompile_headers(${target} REUSE_FROM zelmars_pch_screens)
    else()
        target_precompile_headers(${target} REUSE_FROM zelmars_pch_core)
    endif()
endfunction()

# zelmars_ground(NAME [WIDGETS] SOURCES … LINKS …): a folder of platform/. It is a shared object,
# because its state (the pending error, the default instances, the event filter) exists once in a
# process, also when the host and four components use it.
function(zelmars_ground name)
    cmake_parse_arguments(ZELMARS "WIDGETS" "" "SOURCES;LINKS" ${ARGN})
    add_library(${name} SHARED ${ZELMARS_SOURCES})
    set_target_properties(${name} PROPERTIES OUTPUT_NAME zelmars-${name} DEFINE_SYMBOL "")
    set_property(GLOBAL APPEND PROPERTY ZELMARS_DELIVERED ${name})
    target_link_libraries(${name} PUBLIC Qt6::Core ${ZELMARS_LINKS})
    zelmars_settle(${name})
endfunction()

# zelmars_room(NAME [WIDGETS] SOURCES … LINKS …): a room of the work; a static part of the component.
function(zelmars_room name)
    cmake_parse_arguments(ZELMARS "WIDGETS" "" "SOURCES;LINKS" ${ARGN})
    add_library(${name} STATIC ${ZELMARS_SOURCES})
    target_link_libraries(${name} PUBLIC Qt6::Core ${ZELMARS_LINKS})
    zelmars_settle(${name})
endfunction()

# zelmars_component(NAME OUTPUT [WIDGETS] SOURCES … LINKS …): a shared object with the four entry
# points; OUTPUT is the file's name without "lib" and ".so".
function(zelmars_component name output)
    cmake_parse_arguments(ZELMARS "WIDGETS" "" "SOURCES;LINKS" ${ARGN})
    add_library(${name} SHARED ${ZELMARS_SOURCES})
    set_target_properties(${name} PROPERTIES OUTPUT_NAME ${output} DEFINE_SYMBOL "")
    set_property(GLOBAL APPEND PROPERTY ZELMARS_DELIVERED ${name})
    target_link_libraries(${name} PUBLIC Qt6::Core ${ZELMARS_LINKS})
    zelmars_settle(${name})
endfunction()

# zelmars_program(NAME [WIDGETS] SOURCES … LINKS …)
function(zelmars_program name)
    cmake_parse_arguments(ZELMARS "WIDGETS" "" "SOURCES;LINKS" ${ARGN})
    add_executable(${name} ${ZELMARS_SOURCES})
    target_link_libraries(${name} PRIVATE Qt6::Core ${ZELMARS_LINKS})
    zelmars_settle(${name})
endfunction()

# zelmars_suite(NAME [WIDGETS] [ENGINES …] SOURCES … LINKS …): a test program, one ctest entry. With
# ENGINES sqlite postgresql there is a second entry, NAME@postgresql, whose books lie on a server of
# the run's own; with postgresql alone they do in the only one. A forgotten message box fails by the
# time-out instead of hanging.
function(zelmars_suite name)
    cmake_parse_arguments(ZELMARS "WIDGETS" "TIMEOUT" "ENGINES;SOURCES;LINKS;NEEDS" ${ARGN})
    if(NOT ZELMARS_TIMEOUT)
        set(ZELMARS_TIMEOUT 120)
    endif()
    if(ZELMARS_SANITIZE)
        math(EXPR ZELMARS_TIMEOUT "${ZELMARS_TIMEOUT} * 4")
    endif()
    set(ZELMARS_WIDGETS ON)  # every suite runs under one QApplication
    add_executable(test_${name} ${ZELMARS_SOURCES})
    target_link_libraries(test_${name} PRIVATE test_support ${ZELMARS_LINKS})
    if(ZELMARS_NEEDS)
        add_dependencies(test_${name} ${ZELMARS_NEEDS})
    endif()
    zelmars_settle(test_${name})
    set(surroundings "QT_QPA_PLATFORM=offscreen" "LC_ALL=C.UTF-8" "TZ=Europe/Lisbon")
    if(NOT ZELMARS_ENGINES)
        set(ZELMARS_ENGINES sqlite)
    endif()
    set(entry ${name})
    foreach(engine ${ZELMARS_ENGINES})
        add_test(NAME ${entry} COMMAND test_${name})
        set_tests_properties(${entry} PROPERTIES TIMEOUT ${ZELMARS_TIMEOUT}
            ENVIRONMENT "${surroundings};ZELMARS_TEST_ENGINE=${engine}")
        set(entry ${name}@postgresql)
    endforeach()
endfunction()
