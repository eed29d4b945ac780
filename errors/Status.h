// Status: the library-wide error status.
//
// A Status is a 32-bit code (negative error, positive warning, 0 success) with
// a structured error description: a JSON document that the error translator
// turns into localized text (the helpers in ErrorDescription.h build it).
//
// Setting a code follows one rule everywhere: the new code replaces the held
// one only when the held code is 0 and the new one is not, or when the held
// code is a warning and the new one is an error. An error, once held, is never
// replaced. When a code is replaced, the setter's source location (component,
// file, line) is recorded in the description.
//
// A Status is a value: copies are deep. It is not synchronized; one thread
// owns it at a time.
#pragma once

#include <rapidjson/document.h>

#include <cstdint>
#include <source_location>
#include <string>

namespace hsdig {

// The component name recorded with every source location this library sets.
inline constexpr const char* kComponentName = "hsdigRemote";

class Status {
 public:
  Status() = default;
  // A Status holding `code`, set from `where`.
  explicit Status(int32_t code,
                  const std::source_location& where = std::source_location::current());

  Status(const Status& other);
  Status& operator=(const Status& other);
  Status(Status&& other) noexcept;
  Status& operator=(Status&& other) noexcept;
  ~Status() = default;

  int32_t code() const noexcept { return code_; }
  bool isError() const noexcept { return code_ < 0; }
  bool isWarning() const noexcept { return code_ > 0; }
  bool isSuccess() const noexcept { return code_ == 0; }

  // Applies the replacement rule. Returns true when `code` replaced the held
  // code; then the description records `where` and, when given, the text of
  // the expression that produced the code.
  bool set(int32_t code, const std::source_location& where = std::source_location::current(),
           const char* expression = nullptr);

  // True when `incoming` would replace `held` under the replacement rule.
  static bool replaces(int32_t held, int32_t incoming) noexcept {
    return (held == 0 && incoming != 0) || (held > 0 && incoming < 0);
  }

  // Takes over code and description of `other` unconditionally (the copy of
  // an exception's status into a caller's Status).
  void assign(const Status& other) { *this = other; }

  // Back to success with an empty description.
  void reset();

  // Sets the code outside the replacement rule, keeping the description.
  // Only for moving a held code into another numbering of the same status
  // (an infrastructure code mapped into the driver's range).
  void renumber(int32_t code) noexcept { code_ = code; }

  // The structured error description. It is a JSON null until something is
  // written; writers make it an object. The document owns its allocator.
  rapidjson::Document& description() noexcept { return description_; }
  const rapidjson::Document& description() const noexcept { return description_; }
  bool hasDescription() const noexcept { return description_.IsObject(); }

  // The description as compact JSON text; empty when there is none.
  std::string descriptionJson() const;

  // Replaces the description by the parsed `json`. Returns false (and leaves
  // the description unchanged) when `json` is not a JSON object.
  bool setDescriptionJson(const std::string& json);

 private:
  int32_t code_ = 0;
  rapidjson::Document description_;
};

}  // namespace hsdig
