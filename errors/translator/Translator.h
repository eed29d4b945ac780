// One translator: an interpreter state running the "cvxlatorlua" glue over a
// named translator script ("mxlator") with its settings.
//
// Creation follows the settings document: the translator name is read from
// "cvxlatorlua_xlator", the object "cvxlatorlua_settings" is handed to the
// script. Every call runs protected; a script error becomes a
// TranslationFailure whose status records an internal error with "api"
// "lua", the interpreter's status as "code" and the message as "string".
// A Translator is used by one thread at a time.
#pragma once

#include <cstdint>
#include <memory>
#include <stdexcept>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

#include "errors/Status.h"

struct lua_State;

namespace hsdig::translator {

inline constexpr int32_t kCodeOutOfMemory = -52000;
inline constexpr int32_t kCodeInternal = -52003;
inline constexpr int32_t kCodeUnsupportedFormat = -52029;

// The settings of the translator that renders this system's descriptions.
inline constexpr const char* kTranslatorSettings =
    R"({"cvxlatorlua_xlator":"mxlator","cvxlatorlua_settings":{"driverName":"hsdig",)"
    R"("cvSharedErrorsDir":"$_cvShared32Dir/Errors","QMErrorsDir":"$_cvShared32Dir/QMerrors"}})";

inline constexpr const char* kDescriptionNotFound = "Error description not found";

// A failed translation step. `partialText` is what the step produced before
// it failed (for example "Error description not found" when an explanation
// file was broken); the caller may still show it.
class TranslationFailure : public std::runtime_error {
 public:
  TranslationFailure(int32_t code, const std::string& message, std::string partialText = {});
  int32_t code() const noexcept { return status_.code(); }
  const Status& status() const noexcept { return status_; }
  Status& status() noexcept { return status_; }
  const std::string& partialText() const noexcept { return partialText_; }

 private:
  Status status_;
  std::string partialText_;
};

class LuaState;

// What the text formatting needs of a translator: the built-in one below,
// or one of the translator manager library.
class XlatorInterface {
 public:
  virtual ~XlatorInterface() = default;
  // The static description of `code`. Throws TranslationFailure, with the
  // text found so far as partial text, when a step failed.
  virtual std::string getStaticDesc(int32_t code, int language, int ade) = 0;
  // The dynamic items of a description as JSON text
  // {"dynamic": [...], "debug": [...]}. Throws TranslationFailure; a format
  // other than "json1" fails with code -52029.
  virtual std::string getDynamicDesc(std::string_view errjson, int language, int ade,
                                     std::string_view format) = 0;
};

class Translator : public XlatorInterface {
 public:
  // Throws TranslationFailure: "failed to create lua state", "failed to add
  // embedded modules to preload table", "lua setupEnv failed".
  Translator(std::string_view settingsJson, std::string sharedFolder);
  ~Translator() override;
  Translator(const Translator&) = delete;
  Translator& operator=(const Translator&) = delete;

  // The static description of `code` (mapped codes are looked up by their
  // original value). Throws TranslationFailure, with the text found so far
  // as partial text, when a step failed.
  std::string getStaticDesc(int32_t code, int language, int ade);

  // The dynamic items of a description as JSON text
  // {"dynamic": [...], "debug": [...]}. A format other than "json1" throws
  // TranslationFailure with code -52029.
  std::string getDynamicDesc(std::string_view errjson, int language, int ade,
                             std::string_view format);

  // Every code of the language's static table (English where the language
  // has none) with its text, in code order.
  std::vector<std::pair<int32_t, std::string>> listStaticDescs(int language);

  // The interpreter, for tests that inspect the loaded modules.
  lua_State* state() noexcept;

 private:
  // Calls glue function `name` with the `nargs` values on the stack.
  void call(const char* name, int nargs, int nresults);

  std::unique_ptr<LuaState> lua_;
  int glueRef_ = -1;
};

}  // namespace hsdig::translator
