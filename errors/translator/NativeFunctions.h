// Native functions of the translator's interpreter.
//
// "cvxlatorlua_setupEnv" is a preloaded module whose value is the
// environment setup function (name, settings JSON): it puts the native
// helpers into the "cvxlatorluautils" module, sets the error handler
// "cvxlatorlua_errHandler" as a global, and hands name and settings to the
// "cvxlatorlua" glue, which loads the named translator script.
//
// Native helpers of "cvxlatorluautils":
//   mbsToUtf8(language, text)          text in the language's code page to UTF-8
//   expandPath(path)                   "$_cvShared32Dir" / "$_cvSharedDir" expanded
//   searchQMErrors(dir, driver, language, code)
//       the error files of dir/driver/<long language name>, then of
//       dir/driver/English; texts converted from the code page to UTF-8
//   searchSharedErrors(dir, language, code)
//       the error files of dir/<long language name>, then of dir/English
//   mapErrorCode(code), unmapErrorCode(code)
// A search answers the text, or nil and the first failure met (nil when
// nothing failed).
#pragma once

#include <string>

struct lua_State;

namespace hsdig::translator {

// The registry field that holds the shared folder used by expandPath.
inline constexpr const char* kSharedFolderKey = "hsdig.translator.sharedFolder";

// package.preload loader of "cvxlatorlua_setupEnv".
int luaopen_setupEnv(lua_State* L);

// "English", "French", "German", "Japanese", "Korean", "ChineseS"; any other
// language index reads as English.
const char* longLanguageName(int language) noexcept;

}  // namespace hsdig::translator
