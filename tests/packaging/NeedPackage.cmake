# Read by ctest behind the list of the tests that were found.
foreach(test IN LISTS packaging_tests_TESTS)
    if(test MATCHES "^(Window)?Package\\.")
        set_tests_properties(${test} PROPERTIES FIXTURES_REQUIRED package)
    endif()
endforeach()
