#include "errors/Status.h"

#include <rapidjson/stringbuffer.h>
#include <rapidjson/writer.h>

#include <cstring>

namespace hsdig {

namespace {

// Source paths are recorded by their file name only: the build machine's
// folders mean nothing to the reader of an error text.
const char* baseName(const char* path) {
  const char* slash = std::strrchr(path, '/');
  return slash ? slash + 1 : path;
}

void setMember(rapidjson::Document& doc, const char* key, rapidjson::Value value) {
  auto& alloc = doc.GetAllocator();
  auto found = doc.FindMember(key);
  if (found != doc.MemberEnd()) {
    found->value = value;
  } else {
    doc.AddMember(rapidjson::Value(key, alloc), value, alloc);
  }
}

}  // namespace

Status::Status(int32_t code, const std::source_location& where) {
  set(code, where);
}

Status::Status(const Status& other) : code_(other.code_) {
  description_.CopyFrom(other.description_, description_.GetAllocator());
}

Status& Status::operator=(const Status& other) {
  if (this != &other) {
    rapidjson::Document fresh;
    fresh.CopyFrom(other.description_, fresh.GetAllocator());
    description_.Swap(fresh);
    code_ = other.code_;
  }
  return *this;
}

Status::Status(Status&& other) noexcept : code_(other.code_) {
  description_.Swap(other.description_);
  other.code_ = 0;
}

Status& Status::operator=(Status&& other) noexcept {
  if (this != &other) {
    description_.Swap(other.description_);
    code_ = other.code_;
    other.code_ = 0;
  }
  return *this;
}

bool Status::set(int32_t code, const std::source_location& where, const char* expression) {
  if (!replaces(code_, code)) return false;
  code_ = code;
  if (!description_.IsObject()) description_.SetObject();
  auto& alloc = description_.GetAllocator();
  setMember(description_, "component", rapidjson::Value(kComponentName, alloc));
  setMember(description_, "file", rapidjson::Value(baseName(where.file_name()), alloc));
  setMember(description_, "line", rapidjson::Value(static_cast<int64_t>(where.line())));
  if (expression != nullptr) {
    setMember(description_, "expression", rapidjson::Value(expression, alloc));
  }
  return true;
}

void Status::reset() {
  code_ = 0;
  rapidjson::Document fresh;
  description_.Swap(fresh);
}

std::string Status::descriptionJson() const {
  if (!description_.IsObject()) return {};
  rapidjson::StringBuffer buffer;
  rapidjson::Writer<rapidjson::StringBuffer> writer(buffer);
  description_.Accept(writer);
  return std::string(buffer.GetString(), buffer.GetSize());
}

bool Status::setDescriptionJson(const std::string& json) {
  rapidjson::Document parsed;
  parsed.Parse(json.data(), json.size());
  if (parsed.HasParseError() || !parsed.IsObject()) return false;
  description_.Swap(parsed);
  return true;
}

}  // namespace hsdig
