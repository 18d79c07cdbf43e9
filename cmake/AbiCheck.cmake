# The binary interface of liblumenutility.so: the linker exports only what the public headers
# declare (abi/liblumenutility.map), and the AbiSymbolList test compares the exported names with
# the committed list abi/liblumenutility.symbols. After a deliberate interface change:
#     cmake --build build --target abi-update
# rewrites the list from the built library; commit it with the change.
find_package(Python3 REQUIRED COMPONENTS Interpreter)

set(LUMEN_ABI_MAP ${PROJECT_SOURCE_DIR}/abi/liblumenutility.map)
target_link_options(lumenutility PRIVATE "LINKER:--version-script=${LUMEN_ABI_MAP}")
set_property(TARGET lumenutility APPEND PROPERTY LINK_DEPENDS ${LUMEN_ABI_MAP})

set(LUMEN_ABI_CHECK ${Python3_EXECUTABLE} ${PROJECT_SOURCE_DIR}/abi/check_abi.py
    --nm ${CMAKE_NM} --library $<TARGET_FILE:lumenutility>
    --symbols ${PROJECT_SOURCE_DIR}/abi/liblumenutility.symbols
    --include ${PROJECT_SOURCE_DIR}/include)
add_custom_target(abi-update
  COMMAND ${LUMEN_ABI_CHECK} --update
  DEPENDS lumenutility
  COMMENT "Recording the symbols liblumenutility.so exports in abi/liblumenutility.symbols"
  VERBATIM)

# Sanitizers add exported symbols of their own (ASan's __odr_asan_gen_* for each global), so
# the list is checked on plain builds only.
if(LUMEN_BUILD_TESTS AND NOT LUMEN_SANITIZE AND NOT LUMEN_FUZZ
   AND NOT CMAKE_CXX_FLAGS MATCHES "-fsanitize")
  add_test(NAME AbiSymbolList
           COMMAND ${LUMEN_ABI_CHECK} --check list
                   --update-command "cmake --build ${PROJECT_BINARY_DIR} --target abi-update")
  add_test(NAME AbiExportsOnlyPublicDeclarations COMMAND ${LUMEN_ABI_CHECK} --check public)
endif()
if(LUMEN_BUILD_TESTS)
  add_test(NAME AbiCheckerFindsChangesAndLeaks
           COMMAND bash ${PROJECT_SOURCE_DIR}/abi/check_abi_test.sh ${Python3_EXECUTABLE}
                   ${PROJECT_SOURCE_DIR})
endif()
