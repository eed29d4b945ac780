// Translator sessions: the entry point that turns a Status (code and
// structured description) into text in a language.
//
// A session caches translators by name for a series of translations
// (`createSession` is the constructor, `destroySession` the destructor). The
// interpreter states behind the translators are expensive to build, so a
// session borrows them from a process-wide pool and gives them back when it
// ends; a state is used by one session, and so by one thread, at a time.
// Sessions themselves are not synchronized: one thread uses a session.
//
// Descriptions name their translator in "translator"; this system writes
// "mxlator_hsdig", which is the built-in translator ("mxlator" over the
// embedded term tables with the settings kTranslatorSettings). A status
// without a description is rendered by the same translator. When the
// translator manager library is installed (ManagerLibrary.h), a session and
// its translators come from it instead; if it cannot make a session, the
// built-in translator is used.
//
// Flags of `translate`:
//   bit 0 (kFlagPlain)       plain text, and the fallbacks below are allowed
//   bit 3 (kFlagDebug)       debug items too; dropped when rendering fails
//   bit 30 (kFlagCodePage)   the text in the language's code page, not UTF-8
// Retries: the given flags; then without bit 3; then, with bit 0, the static
// description alone; then, with bit 0, the static description of the code
// alone (the description left out). The last attempt's text is returned;
// when it failed too, two line breaks and the failure's message follow.
// Whatever fails, the caller receives a text.
#pragma once

#include <cstdint>
#include <map>
#include <memory>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

#include "errors/Status.h"

namespace hsdig::translator {

class Translator;
class XlatorInterface;
class ManagerLibrary;
class ManagerSession;

inline constexpr uint32_t kFlagPlain = 0x1;
inline constexpr uint32_t kFlagDebug = 0x8;
inline constexpr uint32_t kFlagCodePage = 0x40000000;
// The flags the error conversion asks with: plain text in the code page.
inline constexpr uint32_t kConversionFlags = kFlagPlain | kFlagCodePage;

inline constexpr const char* kBuiltInTranslatorName = "mxlator_hsdig";

struct TranslatorOptions {
  // The folder that "$_cvShared32Dir" names; empty means the install-relative
  // shared folder. Tests give each run its own folder.
  std::string sharedFolder;
  // The translator manager library to use; nullptr means the process-wide
  // one ("libcvxlator.so", when installed). Tests hand in their own.
  ManagerLibrary* managerLibrary = nullptr;
  // Use the built-in translator even when a manager library is installed.
  bool builtInOnly = false;
};

// What one translation produced, for callers that want the details.
struct Translation {
  std::string text;
  bool complete = true;  // false when every attempt failed
  int attempts = 0;      // how many attempts ran
  Status failure;        // the last failure met, if any
};

class TranslatorSession {
 public:
  explicit TranslatorSession(TranslatorOptions options = {});
  ~TranslatorSession();
  TranslatorSession(const TranslatorSession&) = delete;
  TranslatorSession& operator=(const TranslatorSession&) = delete;

  // `translate`: the text of `status` in `language`. `result` receives a
  // failure only when no text could be made at all (memory exhaustion);
  // every other failure is reported inside the text.
  void translate(const Status& status, int language, uint32_t flags, std::string& text,
                 Status& result);

  // The same from a code and a description in JSON text (empty for none),
  // with the dynamic format to ask for ("json1" is the only one known).
  Translation render(int32_t code, std::string_view descriptionJson, int language, uint32_t flags,
                     std::string_view format = "json1");

  // The static description of `code`; `known` tells whether one was found.
  std::string staticDescription(int32_t code, int language, bool* known = nullptr);

  // Every code of the static table of `language` with its text.
  std::vector<std::pair<int32_t, std::string>> listStaticDescriptions(int language);

  // The translator of that name, created on first use: the manager
  // library's when the session has one, else the built-in one. Throws
  // TranslationFailure for a name the built-in translator does not know.
  XlatorInterface& xlator(const std::string& name);

  // The built-in translator of that name (tests and the code listing).
  Translator& translator(const std::string& name);

  // True when the translators of this session come from the manager library.
  bool managed() const noexcept { return manager_ != nullptr; }

 private:
  TranslatorOptions options_;
  std::map<std::string, std::unique_ptr<Translator>> translators_;
  // Declared before its translators, so that they end before the session.
  std::unique_ptr<ManagerSession> manager_;
  std::map<std::string, std::unique_ptr<XlatorInterface>> managedXlators_;
};

// Number of idle interpreter states kept per translator and shared folder.
inline constexpr std::size_t kPoolLimit = 4;

// Drops every idle interpreter state of the pool (tests and benchmarks use it
// to measure or check creation from scratch).
void clearTranslatorPool();

}  // namespace hsdig::translator
