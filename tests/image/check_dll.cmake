# Checks a built Windows DLL as it ships:
# - it imports only from DLLs the host's system provides (which functions,
#   for the shipping DLL: check_call_sites.py);
# - given `ceiling`, it is at most that many bytes;
# - it holds no debug information but names the file beside it that does,
#   through which an entry point's address reads as its source line.
#   cmake -Dtool=<objdump> -Daddr2line=<addr2line> -Dlibrary=<dll>
#         [-Dceiling=<bytes>] -P check_dll.cmake
execute_process(COMMAND ${tool} -p -h ${library} OUTPUT_VARIABLE dump RESULT_VARIABLE rc)
if(NOT rc EQUAL 0)
  message(FATAL_ERROR "cannot read ${library}")
endif()

# The import tables: a "DLL Name: X" line for each DLL.
string(REGEX MATCHALL "DLL Name: [^\n]+" dlls "${dump}")
if(NOT dlls)
  message(FATAL_ERROR "${library} has no import tables")
endif()
foreach(row IN LISTS dlls)
  string(REGEX REPLACE "DLL Name: " "" dll "${row}")
  string(TOLOWER "${dll}" name)
  if(NOT name MATCHES "^(kernel32|user32|msvcrt|dravo2)\\.dll$")
    message(FATAL_ERROR "the DLL needs a DLL the host does not provide: ${dll}")
  endif()
endforeach()

if(ceiling)
  file(SIZE ${library} size)
  if(size GREATER ceiling)
    message(FATAL_ERROR "the DLL is ${size} bytes, more than its ceiling of ${ceiling}")
  endif()
  message(STATUS "${size} bytes, within the ceiling of ${ceiling}")
endif()

# Section headers are rows "  n .name  size ...".
if(dump MATCHES "\n +[0-9]+ (\\.debug_[a-z_]+) ")
  message(FATAL_ERROR "the DLL carries debug information (${CMAKE_MATCH_1})")
endif()
if(NOT dump MATCHES "\n +[0-9]+ \\.gnu_debuglink ")
  message(FATAL_ERROR "the DLL does not name its debug file")
endif()
# The address of CreateRunObject: the image base plus the entry of the export
# address table at the index the name table gives.
string(REGEX MATCH "ImageBase\t+([0-9a-f]+)" _ "${dump}")
set(base ${CMAKE_MATCH_1})
string(REGEX MATCH "\n\t\\[ *([0-9]+)\\] CreateRunObject\n" _ "${dump}")
string(REGEX MATCH "\n\t\\[ *${CMAKE_MATCH_1}\\] \\+base\\[ *[0-9]+\\] ([0-9a-f]+) Export RVA" _ "${dump}")
math(EXPR address "0x${base} + 0x${CMAKE_MATCH_1}" OUTPUT_FORMAT HEXADECIMAL)
execute_process(COMMAND ${addr2line} -e ${library} ${address} OUTPUT_VARIABLE line RESULT_VARIABLE rc)
string(STRIP "${line}" line)
if(NOT rc EQUAL 0 OR NOT line MATCHES "/src/frame/lifecycle\\.cpp:[0-9]+$")
  message(FATAL_ERROR "CreateRunObject at ${address} reads as \"${line}\" through the debug file, not as its source line")
endif()
message(STATUS "no debug information inside; CreateRunObject at ${address} reads as ${line}")
