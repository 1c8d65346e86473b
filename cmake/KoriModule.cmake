# One library per folder of src/. Sources are picked up from the folder so that adding a file
# needs no edit here; a folder with no sources yet makes no target.
set(KORI_CORE_MODULES "")

# -Wno-restrict: GCC 12 reports false overlaps in std::string concatenation at -O3.
set(KORI_CORE_WARNINGS -Wall -Wextra -Wpedantic -Wshadow -Wconversion
    $<$<CXX_COMPILER_ID:GNU>:-Wno-restrict>)

function(kori_core_module name)
    file(GLOB_RECURSE sources CONFIGURE_DEPENDS
        ${PROJECT_SOURCE_DIR}/src/${name}/*.cpp ${PROJECT_SOURCE_DIR}/src/${name}/*.h)
    list(FILTER sources INCLUDE REGEX "\\.cpp$")
    if(NOT sources)
        return()
    endif()
    add_library(kori_${name} STATIC ${sources})
    target_include_directories(kori_${name} PUBLIC ${PROJECT_SOURCE_DIR}/src)
    target_compile_options(kori_${name} PRIVATE ${KORI_CORE_WARNINGS})
    foreach(dep IN LISTS ARGN)
        if(TARGET kori_${dep})
            target_link_libraries(kori_${name} PUBLIC kori_${dep})
        endif()
    endforeach()
    set(KORI_CORE_MODULES ${KORI_CORE_MODULES} ${name} PARENT_SCOPE)
endfunction()

# tests/<name>/*_test.cpp become one GoogleTest program per module.
function(kori_test_module name)
    file(GLOB_RECURSE sources CONFIGURE_DEPENDS ${PROJECT_SOURCE_DIR}/tests/${name}/*_test.cpp)
    if(NOT sources OR NOT TARGET kori_${name})
        return()
    endif()
    add_executable(kori_${name}_tests ${sources})
    target_link_libraries(kori_${name}_tests PRIVATE kori_${name} kori_test_support GTest::gtest_main
        ${ARGN})
    gtest_discover_tests(kori_${name}_tests DISCOVERY_TIMEOUT 60
        PROPERTIES ENVIRONMENT "KORI_FIXTURES=${PROJECT_SOURCE_DIR}/tests/fixtures")
endfunction()
