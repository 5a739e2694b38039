# The release package, made beside the shipping DLL: tavrin-VERSION.zip with
# the DLL, the author's guide as HTML with every file it links to (pictures,
# recipe scenes), the demo scene, the licence and a checksum file.
find_program(TAVRIN_MARKDOWN markdown_py REQUIRED)  # Debian's python3-markdown
set(package tavrin-${PROJECT_VERSION})
set(zip ${CMAKE_BINARY_DIR}/${package}.zip)
file(GLOB recipes CONFIGURE_DEPENDS ${PROJECT_SOURCE_DIR}/docs/recipes/* ${PROJECT_SOURCE_DIR}/docs/*.png)
add_custom_command(OUTPUT ${zip}
  COMMAND ${CMAKE_COMMAND} -Dsource=${PROJECT_SOURCE_DIR} -Ddll=$<TARGET_FILE:tavrin> -Dpackage=${package}
          -Dmarkdown=${TAVRIN_MARKDOWN} -Dversion=${PROJECT_VERSION}
          -P ${PROJECT_SOURCE_DIR}/cmake/make_release_package.cmake
  WORKING_DIRECTORY ${CMAKE_BINARY_DIR}
  DEPENDS tavrin ${PROJECT_SOURCE_DIR}/cmake/make_release_package.cmake ${PROJECT_SOURCE_DIR}/docs/guide.md
          ${PROJECT_SOURCE_DIR}/LICENSE ${PROJECT_SOURCE_DIR}/tools/scene_player/demo_scene.json ${recipes}
  COMMENT "Making the release package ${package}.zip")
add_custom_target(release_package ALL DEPENDS ${zip})
