# Writes a C++ source that defines the bytes of `input` as the constant
# array `symbol` and its length as `symbol`Size.
#   cmake -Dinput=<file> -Doutput=<file.cpp> -Dsymbol=<name> -P embed_bytes.cmake
file(READ ${input} hex HEX)
string(LENGTH "${hex}" digits)
math(EXPR size "${digits} / 2")
string(REGEX REPLACE "([0-9a-f][0-9a-f])" "0x\\1," bytes "${hex}")
# Sixteen bytes a line keeps the file readable in a diff.
string(REGEX REPLACE "((0x..,){16})" "\\1\n  " bytes "${bytes}")
get_filename_component(name ${input} NAME)
file(WRITE ${output}.tmp
"// Generated from ${name} at build time; do not edit.
#include <cstddef>

alignas(4) extern const unsigned char ${symbol}[] = {
  ${bytes}
};
extern const std::size_t ${symbol}Size = ${size};
")
file(COPY_FILE ${output}.tmp ${output} ONLY_IF_DIFFERENT)
file(REMOVE ${output}.tmp)
