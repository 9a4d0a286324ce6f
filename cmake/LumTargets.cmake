# When the glob finds a new file, AUTOMOC must scan again, but this CMake's Ninja rules do
# not rerun it when only its file list changed; removing its timestamp makes it run.
function(lum_rerun_moc_on_new_files target sources)
    set(list_file ${CMAKE_CURRENT_BINARY_DIR}/${target}_sources.txt)
    set(previous "")
    if(EXISTS ${list_file})
        file(READ ${list_file} previous)
    endif()
    if(NOT previous STREQUAL "${sources}")
        file(WRITE ${list_file} "${sources}")
        file(REMOVE ${CMAKE_CURRENT_BINARY_DIR}/${target}_autogen/timestamp)
    endif()
endfunction()

# One static library per subsystem folder; its sources are the folder's files.
function(lum_subsystem name)
    cmake_parse_arguments(ARG "" "" "DEPS" ${ARGN})
    file(GLOB sources CONFIGURE_DEPENDS
        ${CMAKE_CURRENT_SOURCE_DIR}/*.cpp ${CMAKE_CURRENT_SOURCE_DIR}/*.h
        ${CMAKE_CURRENT_SOURCE_DIR}/*.ui ${CMAKE_CURRENT_SOURCE_DIR}/*.qrc)
    list(FILTER sources EXCLUDE REGEX "/main\\.cpp$")
    set(compiled ${sources})
    list(FILTER compiled INCLUDE REGEX "\\.cpp$")
    if(compiled)
        add_library(lum_${name} STATIC ${sources})
        target_include_directories(lum_${name} PUBLIC ${PROJECT_SOURCE_DIR}/src ${PROJECT_BINARY_DIR}/generated)
        target_link_libraries(lum_${name} PUBLIC ${ARG_DEPS})
        lum_rerun_moc_on_new_files(lum_${name} "${sources}")
    else()
        # A subsystem that has no code yet still exists as a name to link against.
        add_library(lum_${name} INTERFACE)
        target_include_directories(lum_${name} INTERFACE ${PROJECT_SOURCE_DIR}/src ${PROJECT_BINARY_DIR}/generated)
        target_link_libraries(lum_${name} INTERFACE ${ARG_DEPS})
    endif()
endfunction()

# One test executable per tests/ folder, made of its *_test.cpp files.
function(lum_test_folder name)
    cmake_parse_arguments(ARG "" "" "DEPS" ${ARGN})
    file(GLOB sources CONFIGURE_DEPENDS ${CMAKE_CURRENT_SOURCE_DIR}/${name}/*.cpp
        ${CMAKE_CURRENT_SOURCE_DIR}/${name}/*.h)
    if(NOT sources)
        return()
    endif()
    add_executable(test_${name} ${sources})
    set_target_properties(test_${name} PROPERTIES RUNTIME_OUTPUT_DIRECTORY ${CMAKE_BINARY_DIR}/tests)
    target_link_libraries(test_${name} PRIVATE lum_testsupport ${ARG_DEPS} GTest::gtest)
    # Every test file sees the same printers for Qt's strings: readable failures, and one
    # definition of each printer across the program.
    target_compile_options(test_${name} PRIVATE
        "SHELL:-include ${PROJECT_SOURCE_DIR}/tests/support/QtPrinters.h")
    lum_rerun_moc_on_new_files(test_${name} "${sources}")
    gtest_discover_tests(test_${name}
        PROPERTIES ENVIRONMENT "QT_QPA_PLATFORM=offscreen;LUM_SOURCE_DIR=${PROJECT_SOURCE_DIR}"
        DISCOVERY_TIMEOUT 60)
endfunction()
