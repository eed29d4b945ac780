# Turns each Lua file of INPUTS into a byte array of OUTPUT, a C++ source that
# defines hsdig::translator::kEmbeddedModules (see EmbeddedModules.h).
set(body "")
set(entries "")
set(index 0)
foreach(input ${INPUTS})
  get_filename_component(name ${input} NAME_WE)
  file(READ ${input} hex HEX)
  string(LENGTH "${hex}" hexLength)
  math(EXPR size "${hexLength} / 2")
  string(REGEX REPLACE "([0-9a-f][0-9a-f])" "0x\\1," bytes "${hex}")
  string(REGEX REPLACE "((0x[0-9a-f][0-9a-f],){32})" "\\1\n    " bytes "${bytes}")
  string(APPEND body "const unsigned char module${index}[] = {\n    ${bytes}0x00};\n")
  string(APPEND entries "    {\"${name}\", module${index}, ${size}},\n")
  math(EXPR index "${index} + 1")
endforeach()
file(WRITE ${OUTPUT}.tmp
"// Generated from the translator's Lua files by EmbedModules.cmake. Do not edit.
#include \"errors/translator/EmbeddedModules.h\"

namespace hsdig::translator {
namespace {
${body}
}  // namespace

const EmbeddedModule kEmbeddedModules[] = {
${entries}};
const std::size_t kEmbeddedModuleCount = ${index};

}  // namespace hsdig::translator
")
file(COPY_FILE ${OUTPUT}.tmp ${OUTPUT} ONLY_IF_DIFFERENT)
file(REMOVE ${OUTPUT}.tmp)
