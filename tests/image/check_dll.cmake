# Checks a built Windows DLL as it ships:
# - it imports only from DLLs the host's system provides, or, given `imports`
#   (a file of "DLL Function" or "DLL #ordinal" lines), exactly those;
# - given `ceiling`, it is at most that many bytes;
# - it holds no debug information but names the file beside it that does,
#   through which an entry point's address reads as its source line.
#   cmake -Dtool=<objdump> -Daddr2line=<addr2line> -Dlibrary=<dll>
#         [-Dimports=<file>] [-Dceiling=<bytes>] -P check_dll.cmake
execute_process(COMMAND ${tool} -p -h ${library} OUTPUT_VARIABLE dump RESULT_VARIABLE rc)
if(NOT rc EQUAL 0)
  message(FATAL_ERROR "cannot read ${library}")
endif()

# The import tables: a "DLL Name: X" line, then a "vma hint name" row for each
# function, where an import by ordinal shows its ordinal as the hint and
# "<none>" as its name.
string(FIND "${dump}" "The Import Tables" first)
string(FIND "${dump}" "The Export Tables" last)
if(first LESS 0 OR last LESS first)
  message(FATAL_ERROR "${library} has no import tables followed by export tables")
endif()
math(EXPR length "${last} - ${first}")
string(SUBSTRING "${dump}" ${first} ${length} tables)
string(REGEX MATCHALL "DLL Name: [^\n]+|\n\t[0-9a-f]+\t +[0-9]+ +[^\n]+" rows "${tables}")
set(actual "")
set(dlls "")
foreach(row IN LISTS rows)
  if(row MATCHES "DLL Name: ([^\n]+)")
    set(dll ${CMAKE_MATCH_1})
    list(APPEND dlls ${dll})
  elseif(row MATCHES "\t +([0-9]+) +([^ ]+)$")
    if(CMAKE_MATCH_2 STREQUAL "<none>")
      list(APPEND actual "${dll} #${CMAKE_MATCH_1}")
    else()
      list(APPEND actual "${dll} ${CMAKE_MATCH_2}")
    endif()
  endif()
endforeach()
if(imports)
  file(STRINGS ${imports} expected REGEX "^[^#]")
  set(missing ${expected})
  list(REMOVE_ITEM missing ${actual})
  set(extra ${actual})
  list(REMOVE_ITEM extra ${expected})
  if(missing OR extra)
    list(JOIN extra "\n    " extra)
    list(JOIN missing "\n    " missing)
    message(FATAL_ERROR "the DLL's imports differ from ${imports}\n  imported, not listed:\n    ${extra}\n"
                        "  listed, not imported:\n    ${missing}")
  endif()
  list(LENGTH actual count)
  message(STATUS "${count} functions imported, exactly those listed")
else()
  foreach(dll IN LISTS dlls)
    string(TOLOWER "${dll}" name)
    if(NOT name MATCHES "^(kernel32|user32|msvcrt|dravo2)\\.dll$")
      message(FATAL_ERROR "the DLL needs a DLL the host does not provide: ${dll}")
    endif()
  endforeach()
endif()

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
