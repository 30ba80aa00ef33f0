# orvo_gtfs_realtime: generated code for the part of GTFS-Realtime that alerts use, as the benchmarks' yardstick. The program
# itself reads the format by hand and never links this.
find_package(Protobuf QUIET)
if(NOT Protobuf_FOUND)
  return()
endif()
set(generated ${CMAKE_CURRENT_BINARY_DIR}/gtfs_realtime.pb)
add_custom_command(OUTPUT ${generated}.cc ${generated}.h
  COMMAND protobuf::protoc --cpp_out=${CMAKE_CURRENT_BINARY_DIR} --proto_path=${CMAKE_CURRENT_LIST_DIR}
          ${CMAKE_CURRENT_LIST_DIR}/gtfs_realtime.proto
  DEPENDS ${CMAKE_CURRENT_LIST_DIR}/gtfs_realtime.proto)
add_library(orvo_gtfs_realtime STATIC EXCLUDE_FROM_ALL ${generated}.cc)
target_include_directories(orvo_gtfs_realtime SYSTEM PUBLIC ${CMAKE_CURRENT_BINARY_DIR})
target_link_libraries(orvo_gtfs_realtime PUBLIC protobuf::libprotobuf)
