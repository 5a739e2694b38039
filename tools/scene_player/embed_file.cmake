# Writes a C++ source defining scene_player::DemoScene() over the bytes of a
# file, so the program carries the demo scene with it.
#   cmake -DINPUT=demo_scene.json -DOUTPUT=demo_scene_data.cpp -P embed_file.cmake
file(READ "${INPUT}" hex HEX)
string(REGEX REPLACE "([0-9a-f][0-9a-f])" "0x\\1," bytes "${hex}")
string(REGEX REPLACE "(0x..,0x..,0x..,0x..,0x..,0x..,0x..,0x..,0x..,0x..,0x..,0x..,0x..,0x..,0x..,0x..,)" "\\1\n" bytes "${bytes}")
get_filename_component(name "${INPUT}" NAME)
file(WRITE "${OUTPUT}.tmp" "// Made from ${name} at build time.
#include \"demo_scene.h\"

namespace scene_player {

namespace {
const unsigned char kBytes[] = {
${bytes}};
}  // namespace

std::string_view DemoScene() { return {reinterpret_cast<const char*>(kBytes), sizeof kBytes}; }

}  // namespace scene_player
")
file(COPY_FILE "${OUTPUT}.tmp" "${OUTPUT}" ONLY_IF_DIFFERENT)
file(REMOVE "${OUTPUT}.tmp")
