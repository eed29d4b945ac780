// The "json1" text form of a status: its static description, then the
// dynamic items of its structured description one per line, then each
// nested error as its own block, indented by three spaces per level.
//
//   <static description>
//
//   key: value                 a "usage" item (array values joined by ", ")
//   text                       an "elaboration" or "header" item
//                              an "empty" item
//   key: value                 debug items, only when debug output is on
//
//      <nested static description>
//
//      key: value
//
// Blocks are separated by two line breaks; leading and trailing line breaks
// are trimmed. Blank lines are not indented.
#pragma once

#include <rapidjson/document.h>

#include <cstdint>
#include <string>
#include <string_view>

namespace hsdig::translator {

class XlatorInterface;

struct Json1Request {
  int language = 0;
  int ade = 0;         // host development environment, 0 "none"
  bool debug = false;  // show debug items (also when a description asks)
  std::string_view format = "json1";
};

// The full text of `code` with `description` (a JSON object, or nullptr for
// none). Throws TranslationFailure for a failed step or a malformed result.
std::string renderJson1(XlatorInterface& translator, int32_t code,
                        const rapidjson::Value* description, const Json1Request& request);

// The lines of a getDynamicDesc result, validated (exposed for tests).
std::string formatDynamicItems(std::string_view dynamicJson, bool debug);

}  // namespace hsdig::translator
