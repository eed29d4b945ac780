#include "errors/translator/TranslatorSession.h"

#include <rapidjson/document.h>

#include <mutex>
#include <new>

#include "errors/ErrorDescription.h"
#include "errors/translator/CodePage.h"
#include "errors/translator/Json1Formatter.h"
#include "errors/translator/ManagerLibrary.h"
#include "errors/translator/SharedFolder.h"
#include "errors/translator/Translator.h"

namespace hsdig::translator {

namespace {

// Idle translators, keyed by shared folder and translator name. Guarded by
// `mutex`; a translator in the pool belongs to no session.
struct Pool {
  std::mutex mutex;
  std::map<std::string, std::vector<std::unique_ptr<Translator>>> idle;
};

Pool& pool() {
  // Never destroyed: sessions may end during static destruction.
  static Pool* instance = new Pool;
  return *instance;
}

std::string poolKey(const std::string& folder, const std::string& name) {
  return folder + '\n' + name;
}

std::unique_ptr<Translator> takeFromPool(const std::string& key) {
  std::lock_guard lock(pool().mutex);
  auto found = pool().idle.find(key);
  if (found == pool().idle.end() || found->second.empty()) return nullptr;
  auto translator = std::move(found->second.back());
  found->second.pop_back();
  return translator;
}

void giveToPool(const std::string& key, std::unique_ptr<Translator> translator) {
  std::unique_ptr<Translator> surplus;
  std::lock_guard lock(pool().mutex);
  auto& list = pool().idle[key];
  if (list.size() < kPoolLimit) {
    list.push_back(std::move(translator));
  } else {
    surplus = std::move(translator);  // destroyed after the lock is released
  }
}

enum class Form { Full, StaticOnly, CodeOnly };

struct Attempt {
  uint32_t flags;
  Form form;
};

}  // namespace

TranslatorSession::TranslatorSession(TranslatorOptions options) : options_(std::move(options)) {
  if (options_.sharedFolder.empty()) options_.sharedFolder = installSharedFolder();
  if (options_.builtInOnly) return;
  ManagerLibrary& library =
      options_.managerLibrary ? *options_.managerLibrary : ManagerLibrary::process();
  if (!library.available()) return;
  try {
    manager_ = std::make_unique<ManagerSession>(library);
  } catch (const TranslationFailure&) {
    // The built-in translator stands in for a manager that cannot serve.
  }
}

TranslatorSession::~TranslatorSession() {
  managedXlators_.clear();
  manager_.reset();
  for (auto& [name, translator] : translators_) {
    giveToPool(poolKey(options_.sharedFolder, name), std::move(translator));
  }
}

XlatorInterface& TranslatorSession::xlator(const std::string& name) {
  if (!manager_) return translator(name);
  auto found = managedXlators_.find(name);
  if (found != managedXlators_.end()) return *found->second;
  return *managedXlators_.emplace(name, manager_->createXlator(name)).first->second;
}

Translator& TranslatorSession::translator(const std::string& name) {
  auto found = translators_.find(name);
  if (found != translators_.end()) return *found->second;
  if (name != kBuiltInTranslatorName) {
    throw TranslationFailure(kCodeInternal, "unknown translator: " + name);
  }
  auto translator = takeFromPool(poolKey(options_.sharedFolder, name));
  if (!translator)
    translator = std::make_unique<Translator>(kTranslatorSettings, options_.sharedFolder);
  return *translators_.emplace(name, std::move(translator)).first->second;
}

Translation TranslatorSession::render(int32_t code, std::string_view descriptionJson, int language,
                                      uint32_t flags, std::string_view format) {
  Translation out;
  if (code == 0) return out;

  rapidjson::Document description;
  bool hasDescription = false;
  if (!descriptionJson.empty()) {
    description.Parse(descriptionJson.data(), descriptionJson.size());
    hasDescription = true;
  }

  std::vector<Attempt> attempts{{flags, Form::Full}};
  if (flags & kFlagDebug) attempts.push_back({flags & ~kFlagDebug, Form::Full});
  if (flags & kFlagPlain) {
    attempts.push_back({kFlagPlain, Form::StaticOnly});
    attempts.push_back({kFlagPlain, Form::CodeOnly});
  }

  std::string lastPartial;
  for (const Attempt& attempt : attempts) {
    ++out.attempts;
    try {
      bool withDescription = hasDescription && attempt.form != Form::CodeOnly;
      std::string name = kBuiltInTranslatorName;
      if (withDescription) {
        if (description.HasParseError() || !description.IsObject()) {
          throw TranslationFailure(kCodeInternal, "could not find translator key in json");
        }
        auto key = description.FindMember("translator");
        if (key == description.MemberEnd() || !key->value.IsString()) {
          throw TranslationFailure(kCodeInternal, "could not find translator key in json");
        }
        name.assign(key->value.GetString(), key->value.GetStringLength());
      }
      XlatorInterface& t = xlator(name);
      if (attempt.form == Form::Full) {
        Json1Request request{language, 0, (attempt.flags & kFlagDebug) != 0, format};
        out.text = renderJson1(t, code, withDescription ? &description : nullptr, request);
      } else {
        out.text = t.getStaticDesc(code, language, 0);
      }
      out.complete = true;
      out.failure.reset();
      break;
    } catch (const TranslationFailure& failure) {
      out.complete = false;
      out.failure = failure.status();
      lastPartial = failure.partialText();
      out.text = failure.what();
    } catch (const std::bad_alloc&) {
      throw;
    } catch (const std::exception& e) {
      out.complete = false;
      out.failure = Status(kCodeInternal);
      description::addInternalError(out.failure, "std", 0, e.what());
      lastPartial.clear();
      out.text = e.what();
    }
  }
  if (!out.complete) {
    // At worst the static description, or the not-found text, followed by
    // what went wrong.
    std::string message = std::move(out.text);
    out.text = lastPartial.empty() ? std::string(kDescriptionNotFound) : lastPartial;
    if (!message.empty()) out.text += "\n\n" + message;
  }
  if (flags & kFlagCodePage) out.text = utf8ToCodePage(language, out.text);
  return out;
}

void TranslatorSession::translate(const Status& status, int language, uint32_t flags,
                                  std::string& text, Status& result) {
  try {
    text = render(status.code(), status.descriptionJson(), language, flags).text;
  } catch (const std::bad_alloc&) {
    result.set(kCodeOutOfMemory);
    try {
      text = "failed to allocate memory";
    } catch (...) {
    }
  }
}

std::string TranslatorSession::staticDescription(int32_t code, int language, bool* known) {
  if (known) *known = false;
  try {
    std::string text = xlator(kBuiltInTranslatorName).getStaticDesc(code, language, 0);
    if (known) *known = text != kDescriptionNotFound;
    return text;
  } catch (const TranslationFailure& failure) {
    std::string text = failure.partialText().empty() ? kDescriptionNotFound : failure.partialText();
    return text + "\n\n" + failure.what();
  }
}

std::vector<std::pair<int32_t, std::string>> TranslatorSession::listStaticDescriptions(
    int language) {
  return translator(kBuiltInTranslatorName).listStaticDescs(language);
}

void clearTranslatorPool() {
  std::map<std::string, std::vector<std::unique_ptr<Translator>>> dropped;
  {
    std::lock_guard lock(pool().mutex);
    dropped.swap(pool().idle);
  }
}

}  // namespace hsdig::translator
