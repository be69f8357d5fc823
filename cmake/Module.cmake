# The provider module: every subsystem library, whole, in one shared object.
# Only the CMPI entries, tessel_module and the version word are exported
# (cmpi/generated/module.map); everything else stays inside.
if(TARGET vspr_cmpi)
  # The generated provider glue includes every provider's header, so it is
  # built once all the provider directories are known.
  add_library(vspr_providers STATIC "${CMAKE_SOURCE_DIR}/cmpi/generated/providers.cpp")
  target_compile_options(vspr_providers PRIVATE -fvisibility=hidden -fvisibility-inlines-hidden)
  target_link_libraries(vspr_providers PUBLIC vspr_cmpi)
  foreach(lib vspr_schema vspr_model vspr_diag vspr_indication vspr_update vspr_rpc vspr_server)
    if(TARGET ${lib})
      target_link_libraries(vspr_providers PUBLIC ${lib})
    endif()
  endforeach()
  set_property(GLOBAL APPEND PROPERTY VSPR_MODULE_LIBS vspr_providers)

  get_property(vspr_module_libs GLOBAL PROPERTY VSPR_MODULE_LIBS)
  add_library(vsprprovider_Module SHARED "${CMAKE_SOURCE_DIR}/cmake/module_anchor.cpp")
  # The archives go in whole (static registrations must stay), by path: the
  # LINK_LIBRARY feature refuses a library that another one also names
  # without it, as the subsystems' own dependencies do.
  set(_archives)
  foreach(lib ${vspr_module_libs})
    list(APPEND _archives "$<TARGET_FILE:${lib}>")
  endforeach()
  add_dependencies(vsprprovider_Module ${vspr_module_libs})
  target_link_libraries(vsprprovider_Module PRIVATE
    -Wl,--whole-archive ${_archives} -Wl,--no-whole-archive
    PkgConfig::JSONCPP Threads::Threads ${CMAKE_DL_LIBS})
  set(_map "${CMAKE_SOURCE_DIR}/cmpi/generated/module.map")
  target_link_options(vsprprovider_Module PRIVATE
    -Wl,--no-undefined -Wl,--version-script=${_map})
  set_property(TARGET vsprprovider_Module APPEND PROPERTY LINK_DEPENDS ${_map})
  set_target_properties(vsprprovider_Module PROPERTIES
    LIBRARY_OUTPUT_DIRECTORY "${CMAKE_BINARY_DIR}")
endif()
