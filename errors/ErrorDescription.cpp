#include "errors/ErrorDescription.h"

namespace hsdig::description {

namespace {

using rapidjson::Value;

Value text(std::string_view s, rapidjson::Document::AllocatorType& alloc) {
  return Value(s.data(), static_cast<rapidjson::SizeType>(s.size()), alloc);
}

// The member `key` of `object`, created with `init` when missing or of
// another JSON type than `wanted`.
Value& member(Value& object, const char* key, rapidjson::Type wanted,
              rapidjson::Document::AllocatorType& alloc) {
  auto found = object.FindMember(key);
  if (found == object.MemberEnd()) {
    object.AddMember(Value(key, alloc), Value(wanted), alloc);
    return object[key];
  }
  if (found->value.GetType() != wanted) found->value = Value(wanted);
  return found->value;
}

rapidjson::Document& objectOf(Status& status) {
  auto& doc = status.description();
  if (!doc.IsObject()) doc.SetObject();
  return doc;
}

Value& orderedData(Status& status) {
  prepare(status);
  auto& doc = status.description();
  return doc["translator_info"]["ordered_data"];
}

void pushItem(Status& status, const char* type, std::string_view usage, Value* value,
              Value* valueType) {
  auto& alloc = status.description().GetAllocator();
  Value item(rapidjson::kObjectType);
  item.AddMember("type", Value(type, alloc), alloc);
  item.AddMember("usage", text(usage, alloc), alloc);
  if (value) item.AddMember("value", *value, alloc);
  if (valueType) item.AddMember("value_type", *valueType, alloc);
  orderedData(status).PushBack(item, alloc);
}

void pushUsage(Status& status, std::string_view usage, Value value, const char* typeName) {
  auto& alloc = objectOf(status).GetAllocator();
  Value type(typeName, alloc);
  pushItem(status, "usage", usage, &value, &type);
}

}  // namespace

void prepare(Status& status, bool isDebug) {
  auto& doc = objectOf(status);
  auto& alloc = doc.GetAllocator();
  if (!doc.HasMember("translator"))
    doc.AddMember("translator", Value(kTranslatorName, alloc), alloc);
  Value& info = member(doc, "translator_info", rapidjson::kObjectType, alloc);
  if (!info.HasMember("version")) info.AddMember("version", kTranslatorInfoVersion, alloc);
  if (!info.HasMember("is_debug")) info.AddMember("is_debug", isDebug, alloc);
  member(info, "ordered_data", rapidjson::kArrayType, alloc);
}

bool hasOrderedData(const Status& status) {
  const auto& doc = status.description();
  if (!doc.IsObject()) return false;
  auto info = doc.FindMember("translator_info");
  if (info == doc.MemberEnd() || !info->value.IsObject()) return false;
  auto data = info->value.FindMember("ordered_data");
  return data != info->value.MemberEnd() && data->value.IsArray();
}

void addUsage(Status& status, std::string_view usage, int32_t value) {
  pushUsage(status, usage, Value(value), "int32_t");
}
void addUsage(Status& status, std::string_view usage, uint32_t value) {
  pushUsage(status, usage, Value(value), "uint32_t");
}
void addUsage(Status& status, std::string_view usage, int64_t value) {
  pushUsage(status, usage, Value(value), "int64_t");
}
void addUsage(Status& status, std::string_view usage, uint64_t value) {
  pushUsage(status, usage, Value(value), "uint64_t");
}
void addUsage(Status& status, std::string_view usage, double value) {
  pushUsage(status, usage, Value(value), "double");
}
void addUsage(Status& status, std::string_view usage, bool value) {
  pushUsage(status, usage, Value(value), "bool");
}
void addUsage(Status& status, std::string_view usage, std::string_view value) {
  pushUsage(status, usage, text(value, objectOf(status).GetAllocator()), "string");
}
void addUsage(Status& status, std::string_view usage, const char* value) {
  addUsage(status, usage, std::string_view(value ? value : ""));
}
void addUsage(Status& status, std::string_view usage, const std::vector<int32_t>& values) {
  auto& alloc = objectOf(status).GetAllocator();
  Value array(rapidjson::kArrayType);
  for (int32_t v : values) array.PushBack(v, alloc);
  pushUsage(status, usage, std::move(array), "int32_t");
}
void addUsage(Status& status, std::string_view usage, const std::vector<std::string>& values) {
  auto& alloc = objectOf(status).GetAllocator();
  Value array(rapidjson::kArrayType);
  for (const auto& v : values) array.PushBack(text(v, alloc), alloc);
  pushUsage(status, usage, std::move(array), "string");
}

void addEnumUsage(Status& status, std::string_view usage, int32_t value, uint32_t attributeId) {
  auto& alloc = objectOf(status).GetAllocator();
  Value val(value);
  Value type(rapidjson::kObjectType);
  type.AddMember("type", "enum", alloc);
  type.AddMember("id", attributeId, alloc);
  pushItem(status, "usage", usage, &val, &type);
}

void addElaboration(Status& status, std::string_view key) {
  pushItem(status, "elaboration", key, nullptr, nullptr);
}

void addHeader(Status& status, std::string_view key) {
  pushItem(status, "header", key, nullptr, nullptr);
}

void addEmpty(Status& status) {
  auto& alloc = objectOf(status).GetAllocator();
  Value item(rapidjson::kObjectType);
  item.AddMember("type", "empty", alloc);
  orderedData(status).PushBack(item, alloc);
}

void addNestedError(Status& status, const Status& nested) {
  auto& doc = objectOf(status);
  auto& alloc = doc.GetAllocator();
  Value entry(rapidjson::kObjectType);
  if (nested.hasDescription()) entry.CopyFrom(nested.description(), alloc);
  if (entry.HasMember("code")) {
    entry["code"] = nested.code();
  } else {
    entry.AddMember("code", nested.code(), alloc);
  }
  member(doc, "nested_error", rapidjson::kArrayType, alloc).PushBack(entry, alloc);
}

void addInternalError(Status& status, std::string_view api, int64_t code, std::string_view text_) {
  auto& doc = objectOf(status);
  auto& alloc = doc.GetAllocator();
  Value record(rapidjson::kObjectType);
  record.AddMember("api", text(api, alloc), alloc);
  record.AddMember("code", code, alloc);
  record.AddMember("string", text(text_, alloc), alloc);
  member(doc, "internal_error", rapidjson::kArrayType, alloc).PushBack(record, alloc);
}

}  // namespace hsdig::description
