# Each layer folder holds its sources and, beside them, tests named *_test.cpp.
# lumen_add_layer(<folder>) adds the folder's sources to the library and remembers its tests.
set(LUMEN_TEST_SOURCES "" CACHE INTERNAL "")

function(lumen_add_layer folder)
  file(GLOB sources CONFIGURE_DEPENDS "${PROJECT_SOURCE_DIR}/${folder}/*.cpp")
  file(GLOB tests CONFIGURE_DEPENDS "${PROJECT_SOURCE_DIR}/${folder}/*_test.cpp")
  if(tests)
    list(REMOVE_ITEM sources ${tests})
  endif()
  if(sources)
    target_sources(lumenutility_objects PRIVATE ${sources})
  endif()
  if(tests AND LUMEN_BUILD_TESTS)
    add_executable(${folder}_tests ${tests})
    target_link_libraries(${folder}_tests PRIVATE lumenutility_internal GTest::gtest_main)
    target_compile_options(${folder}_tests PRIVATE -Wall -Wextra)
    set_target_properties(${folder}_tests PROPERTIES
      RUNTIME_OUTPUT_DIRECTORY ${PROJECT_BINARY_DIR}/${folder})
    set_property(GLOBAL APPEND PROPERTY LUMEN_TEST_TARGETS ${folder}_tests)
  endif()
endfunction()

function(lumen_register_layer_tests)
  get_property(targets GLOBAL PROPERTY LUMEN_TEST_TARGETS)
  foreach(target IN LISTS targets)
    gtest_discover_tests(${target} DISCOVERY_TIMEOUT 60
                         PROPERTIES ENVIRONMENT "LUMEN_SOURCE_DIR=${PROJECT_SOURCE_DIR}")
  endforeach()
endfunction()
