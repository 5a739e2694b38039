# Makes the release package in the current folder:
#   cmake -Dsource=<repository> -Ddll=<tavrin.dll> -Dpackage=tavrin-<version> -Dversion=<version>
#         -Dmarkdown=<markdown_py> -P make_release_package.cmake
# The guide becomes guide.html; every file it links to is packed at the path
# the link gives, so the links work in the unpacked folder.
set(docs ${source}/docs)
file(REMOVE_RECURSE ${package} ${package}.zip)
file(MAKE_DIRECTORY ${package})

execute_process(COMMAND ${markdown} -x tables -x toc -o html ${docs}/guide.md
                OUTPUT_VARIABLE body RESULT_VARIABLE failed)
if(failed)
  message(FATAL_ERROR "cannot make HTML of ${docs}/guide.md")
endif()
file(WRITE ${package}/guide.html "<!DOCTYPE html>
<html lang=\"en\"><head><meta charset=\"utf-8\">
<title>Tavrin ${version}: the author's guide</title>
<style>
body { font-family: sans-serif; max-width: 50em; margin: 2em auto; padding: 0 1em; line-height: 1.45; }
table { border-collapse: collapse; } th, td { border: 1px solid #bbb; padding: 0.2em 0.5em; vertical-align: top; }
code { white-space: pre-wrap; background: #f2f2f2; }
</style></head><body>
${body}
</body></html>
")

file(STRINGS ${docs}/guide.md lines REGEX "\\]\\([^)#:]+\\)")
set(linked "")
foreach(line IN LISTS lines)
  string(REGEX MATCHALL "\\]\\([^)#:]+\\)" links "${line}")
  foreach(link IN LISTS links)
    string(REGEX REPLACE "^\\]\\((.*)\\)$" "\\1" path "${link}")
    list(APPEND linked ${path})
  endforeach()
endforeach()
list(REMOVE_DUPLICATES linked)
foreach(path IN LISTS linked)
  get_filename_component(folder ${package}/${path} DIRECTORY)
  file(COPY ${docs}/${path} DESTINATION ${folder})
endforeach()
file(COPY ${dll} ${source}/LICENSE DESTINATION ${package})
file(COPY_FILE ${source}/tools/scene_player/demo_scene.json ${package}/demo-scene.json)

# One "checksum  path" line for every other file, as sha256sum -c reads it.
file(GLOB_RECURSE files RELATIVE ${CMAKE_CURRENT_BINARY_DIR}/${package} ${package}/*)
list(SORT files)
set(sums "")
foreach(path IN LISTS files)
  file(SHA256 ${package}/${path} sum)
  string(APPEND sums "${sum}  ${path}\n")
endforeach()
file(WRITE ${package}/SHA256SUMS "${sums}")

file(ARCHIVE_CREATE OUTPUT ${package}.zip PATHS ${package} FORMAT zip)
message(STATUS "${CMAKE_CURRENT_BINARY_DIR}/${package}.zip")
