# add_veltrix_test(<name> SOURCES <files...> [LIBS <targets...>])
# One Qt Test executable registered with ctest, run without a display.
function(add_veltrix_test name)
  cmake_parse_arguments(ARG "" "" "SOURCES;LIBS" ${ARGN})
  add_executable(${name} ${ARG_SOURCES})
  target_link_libraries(${name} PRIVATE Qt6::Test veltrix_core ${ARG_LIBS})
  target_include_directories(${name} PRIVATE ${PROJECT_SOURCE_DIR}/tests/support)
  target_compile_definitions(${name} PRIVATE
    VELTRIX_NEW_DB="${VELTRIX_NEW_DB}"
    VELTRIX_TEST_HELPER="$<TARGET_FILE:veltrix-testhelper>"
    VELTRIX_MW_SIM="$<TARGET_FILE:veltrix-mw-sim>"
    VELTRIX_PGCLUSTER="${PROJECT_SOURCE_DIR}/tests/support/pgcluster")
  add_dependencies(${name} new_db veltrix-testhelper veltrix-mw-sim)
  add_test(NAME ${name} COMMAND ${name})
  set_tests_properties(${name} PROPERTIES
    ENVIRONMENT "QT_QPA_PLATFORM=offscreen;LC_ALL=C.UTF-8"
    TIMEOUT 300)
endfunction()
