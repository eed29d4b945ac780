# Writes the method table header from the thrift compiler's JSON description
# of hsdig.thrift, so the list of methods has one source: the IDL.
#   cmake -DJSON=hsdig.json -DOUT=hsdigEP_methods.h -P generate_method_table.cmake
file(READ ${JSON} doc)
string(JSON service GET "${doc}" services 0)
string(JSON service_name GET "${service}" name)
string(JSON count LENGTH "${service}" functions)
math(EXPR last "${count} - 1")

set(xlist "")
set(traits "")
set(names "")
foreach(i RANGE ${last})
  string(JSON fn GET "${service}" functions ${i})
  string(JSON name GET "${fn}" name)
  string(JSON return_id GET "${fn}" returnTypeId)
  string(JSON nargs LENGTH "${fn}" arguments)
  math(EXPR index "${i} + 1")

  set(call_args "")
  set(has_nulls false)
  if(nargs GREATER 0)
    math(EXPR alast "${nargs} - 1")
    foreach(a RANGE ${alast})
      string(JSON aname GET "${fn}" arguments ${a} name)
      if(aname STREQUAL "nulls")
        set(has_nulls true)
      endif()
      string(APPEND call_args ", args.${aname}")
    endforeach()
  endif()

  if(return_id STREQUAL "void")
    set(success "void")
    set(has_result false)
    set(void_args "")
    if(nargs GREATER 0)
      string(SUBSTRING "${call_args}" 2 -1 void_args)
    endif()
    set(invoke "iface.${name}(${void_args});")
    set(unused "(void)result;")
  else()
    string(JSON success GET "${fn}" returnType class)
    set(has_result true)
    set(invoke "iface.${name}(result.success${call_args});")
    set(unused "")
  endif()
  if(nargs EQUAL 0)
    string(APPEND unused " (void)args;")
  endif()

  string(APPEND xlist "  X(${index}, ${name}) \\\n")
  string(APPEND names "    \"${name}\",\n")
  string(APPEND traits "
struct ${name} {
  static constexpr int index = ${index};
  static constexpr const char* wireName = \"${name}\";
  static constexpr bool hasResult = ${has_result};
  static constexpr bool hasNulls = ${has_nulls};
  static constexpr int argumentCount = ${nargs};
  using Args = ${service_name}_${name}_args;
  using PArgs = ${service_name}_${name}_pargs;
  using Result = ${service_name}_${name}_result;
  using PResult = ${service_name}_${name}_presult;
  using Success = ${success};
  static void invoke(${service_name}If& iface, Result& result, const Args& args) {
    ${unused} ${invoke}
  }
};
")
endforeach()

file(WRITE ${OUT}.tmp "// Generated from contract/hsdig.thrift by generate_method_table.cmake; do not edit.
//
// The method table of the service ${service_name}: one traits record per method, in
// declaration order, and the list macro HSDIG_EP_METHODS(X) that expands
// X(index, wireName) for each. The dispatcher, the handlers and the client
// exports iterate this table instead of listing the methods by hand.
#pragma once

#include <array>
#include <string_view>

#include \"${service_name}.h\"

namespace hsdig::methods {

inline constexpr int kCount = ${count};

#define HSDIG_EP_METHODS(X) \\
${xlist}
${traits}
// Wire names in declaration order.
inline constexpr std::array<std::string_view, kCount> kWireNames = {
${names}};

}  // namespace hsdig::methods
")
# Replace the header only when it changed, so dependents rebuild only then.
file(COPY_FILE ${OUT}.tmp ${OUT} ONLY_IF_DIFFERENT)
file(REMOVE ${OUT}.tmp)
