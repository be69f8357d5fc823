# The provider module: every subsystem library, whole, in one shared object.
# Only the CMPI entries, tessel_module and the version word are exported;
# everything else is compiled with hidden visibility.
get_property(vspr_module_libs GLOBAL PROPERTY VSPR_MODULE_LIBS)
if(TARGET vspr_cmpi)
  add_library(vsprprovider_Module SHARED "${CMAKE_SOURCE_DIR}/cmake/module_anchor.cpp")
  target_link_libraries(vsprprovider_Module PRIVATE
    "$<LINK_LIBRARY:WHOLE_ARCHIVE,${vspr_module_libs}>"
    PkgConfig::JSONCPP Threads::Threads ${CMAKE_DL_LIBS})
  target_link_options(vsprprovider_Module PRIVATE -Wl,--no-undefined)
endif()
