# Helpers shared by the subsystem directories.

# vspr_subsystem(NAME [LIBS ...]): a static, position-independent library
# vspr_NAME from every .cpp in the calling directory. It joins the provider
# module (whole archive, so that static registrations are kept). A directory
# of headers only (providers that implement nothing yet) gives an interface
# library, which has nothing to join.
function(vspr_subsystem name)
  cmake_parse_arguments(ARG "" "" "LIBS" ${ARGN})
  file(GLOB srcs CONFIGURE_DEPENDS "${CMAKE_CURRENT_SOURCE_DIR}/*.cpp")
  if(NOT srcs)
    add_library(vspr_${name} INTERFACE)
    target_include_directories(vspr_${name} INTERFACE "${CMAKE_CURRENT_SOURCE_DIR}")
    if(ARG_LIBS)
      target_link_libraries(vspr_${name} INTERFACE ${ARG_LIBS})
    endif()
    return()
  endif()
  add_library(vspr_${name} STATIC ${srcs})
  target_include_directories(vspr_${name} PUBLIC "${CMAKE_CURRENT_SOURCE_DIR}")
  target_compile_options(vspr_${name} PRIVATE -fvisibility=hidden -fvisibility-inlines-hidden)
  if(ARG_LIBS)
    target_link_libraries(vspr_${name} PUBLIC ${ARG_LIBS})
  endif()
  set_property(GLOBAL APPEND PROPERTY VSPR_MODULE_LIBS vspr_${name})
endfunction()

# vspr_tests(LIBS ...): one GoogleTest executable per test_*.cpp in the
# calling directory, so that one broken test file never hides the others.
function(vspr_tests)
  cmake_parse_arguments(ARG "" "PREFIX" "LIBS;PROPERTIES" ${ARGN})
  file(GLOB tests CONFIGURE_DEPENDS "${CMAKE_CURRENT_SOURCE_DIR}/test_*.cpp")
  foreach(src ${tests})
    get_filename_component(base ${src} NAME_WE)
    set(exe ${ARG_PREFIX}${base})
    add_executable(${exe} ${src})
    target_link_libraries(${exe} PRIVATE ${ARG_LIBS} GTest::gtest GTest::gtest_main Threads::Threads)
    # The tree's locations as compile definitions: a list-valued ENVIRONMENT
    # property would be split apart by gtest_discover_tests.
    target_compile_definitions(${exe} PRIVATE
      VSPR_BUILD_DIR="${CMAKE_BINARY_DIR}" VSPR_SOURCE_DIR="${CMAKE_SOURCE_DIR}")
    vspr_discover_tests(${exe} PROPERTIES ${ARG_PROPERTIES})
  endforeach()
endfunction()

# vspr_discover_tests(EXE [PREFIX p] [PROPERTIES ...]): the executable's tests
# for CTest. A test whose name holds "WithAgentRunning" starts a process
# named like the console agent, which every test that reads the process list
# (any test of the remote access point, directly or through an association)
# would see: such a test runs alone, and the others side by side.
function(vspr_discover_tests exe)
  cmake_parse_arguments(ARG "" "PREFIX" "PROPERTIES" ${ARGN})
  set(props ${ARG_PROPERTIES})
  if(NOT props)
    set(props TIMEOUT 300)
  endif()
  gtest_discover_tests(${exe} DISCOVERY_TIMEOUT 60 TEST_PREFIX "${ARG_PREFIX}"
    TEST_FILTER "-*WithAgentRunning*" PROPERTIES ${props})
  gtest_discover_tests(${exe} DISCOVERY_TIMEOUT 60 TEST_PREFIX "${ARG_PREFIX}"
    TEST_FILTER "*WithAgentRunning*" PROPERTIES ${props} RUN_SERIAL TRUE)
endfunction()
