# platform_library(NAME SOURCES file... [LIBRARIES lib...] [INTERFACES lib...])
#
# One platform interface: platform/NAME/include is what its users see, platform/NAME/src nobody
# else's business, platform/NAME/host what companions and tools of the phone may call in addition.
# LIBRARIES are used inside; INTERFACES stand in the public headers. Shared, as on the phone: a test
# can put its own version of any single call in front.
function(platform_library name)
  cmake_parse_arguments(ARG "" "" "SOURCES;LIBRARIES;INTERFACES" ${ARGN})
  add_library(platform_${name} SHARED ${ARG_SOURCES})
  add_library(platform::${name} ALIAS platform_${name})
  target_include_directories(platform_${name} PUBLIC include PRIVATE src host)
  target_link_libraries(platform_${name} PUBLIC ${ARG_INTERFACES} PRIVATE ${ARG_LIBRARIES})
  set_target_properties(platform_${name} PROPERTIES OUTPUT_NAME zelqo-${name} VERSION 1)
  install(TARGETS platform_${name} LIBRARY DESTINATION lib/zelqo-phone NAMELINK_SKIP)

  add_library(platform_${name}_host INTERFACE)
  add_library(platform::${name}_host ALIAS platform_${name}_host)
  target_include_directories(platform_${name}_host INTERFACE ${CMAKE_CURRENT_SOURCE_DIR}/host)
  target_link_libraries(platform_${name}_host INTERFACE platform_${name})
endfunction()

# The platform interfaces that the viewer is written against, and their pkg-config names on a device.
set(VIEWER_PLATFORM
  app_assist appfw settings contacts media mime connection notification theme dlog zelqo ovu usagelog)
set(DEVICE_MODULES
  app-assist capi-appfw-application bundle aul ui-gadget-1 capi-system-system-settings vconf
  contacts-service2 capi-content-media-content capi-content-mime-type capi-network-connection
  notification efl-assist uxt-theme dlog zelqo-client ovu-client orlant-log-manager)
