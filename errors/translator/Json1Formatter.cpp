#include "errors/translator/Json1Formatter.h"

#include <rapidjson/stringbuffer.h>
#include <rapidjson/writer.h>

#include <vector>

#include "errors/translator/Translator.h"

namespace hsdig::translator {

namespace {

constexpr const char* kItemNotObject =
    "json1 dynamic object invalid. each array item must be an object";
constexpr const char* kBadValueItem =
    "json1 dynamic object invalid. something's wrong with value item";
constexpr const char* kValueNotString = "json1 dynamic object invalid. value can only be string";
constexpr const char* kNestedNotArray = "nested_error contains invalid json type";
constexpr const char* kNestedElementInvalid =
    "nested_error contains invalid json type on one of the element";

[[noreturn]] void fail(const char* message) {
  throw TranslationFailure(kCodeInternal, message);
}

std::string valueText(const rapidjson::Value& item) {
  auto value = item.FindMember("value");
  if (value == item.MemberEnd()) fail(kBadValueItem);
  if (value->value.IsString()) return {value->value.GetString(), value->value.GetStringLength()};
  if (!value->value.IsArray()) fail(kValueNotString);
  std::string joined;
  bool first = true;
  for (const auto& element : value->value.GetArray()) {
    if (!element.IsString()) fail(kValueNotString);
    if (!first) joined += ", ";
    joined.append(element.GetString(), element.GetStringLength());
    first = false;
  }
  return joined;
}

// Appends the lines of one item list ("dynamic" or "debug").
void appendItems(const rapidjson::Value& document, const char* listName,
                 std::vector<std::string>& lines) {
  auto list = document.FindMember(listName);
  if (list == document.MemberEnd()) return;
  // An empty list may arrive as an empty object.
  if (list->value.IsObject() && list->value.MemberCount() == 0) return;
  if (!list->value.IsArray()) fail(kItemNotObject);
  for (const auto& item : list->value.GetArray()) {
    if (!item.IsObject()) fail(kItemNotObject);
    auto type = item.FindMember("type");
    if (type == item.MemberEnd() || !type->value.IsString()) fail(kBadValueItem);
    std::string_view kind(type->value.GetString(), type->value.GetStringLength());
    if (kind == "empty") {
      lines.emplace_back();
    } else if (kind == "usage") {
      auto key = item.FindMember("key");
      if (key == item.MemberEnd() || !key->value.IsString()) fail(kBadValueItem);
      lines.push_back(std::string(key->value.GetString(), key->value.GetStringLength()) + ": " +
                      valueText(item));
    } else {
      lines.push_back(valueText(item));
    }
  }
}

std::string indent(const std::string& block) {
  std::string out;
  std::size_t start = 0;
  while (start <= block.size()) {
    std::size_t end = block.find('\n', start);
    if (end == std::string::npos) end = block.size();
    if (end > start) out += "   ";
    out.append(block, start, end - start);
    if (end == block.size()) break;
    out.push_back('\n');
    start = end + 1;
  }
  return out;
}

std::string trimLineBreaks(std::string text) {
  std::size_t first = text.find_first_not_of("\r\n");
  if (first == std::string::npos) return {};
  std::size_t last = text.find_last_not_of("\r\n");
  return text.substr(first, last - first + 1);
}

bool asksForDebug(const rapidjson::Value& description) {
  auto info = description.FindMember("translator_info");
  if (info == description.MemberEnd() || !info->value.IsObject()) return false;
  auto flag = info->value.FindMember("is_debug");
  return flag != info->value.MemberEnd() && flag->value.IsBool() && flag->value.GetBool();
}

std::string toJson(const rapidjson::Value& value) {
  rapidjson::StringBuffer buffer;
  rapidjson::Writer<rapidjson::StringBuffer> writer(buffer);
  value.Accept(writer);
  return {buffer.GetString(), buffer.GetSize()};
}

}  // namespace

std::string formatDynamicItems(std::string_view dynamicJson, bool debug) {
  rapidjson::Document document;
  document.Parse(dynamicJson.data(), dynamicJson.size());
  if (document.HasParseError() || !document.IsObject()) fail(kItemNotObject);
  std::vector<std::string> lines;
  appendItems(document, "dynamic", lines);
  if (debug) appendItems(document, "debug", lines);
  std::string out;
  for (std::size_t i = 0; i < lines.size(); ++i) {
    if (i > 0) out.push_back('\n');
    out += lines[i];
  }
  return out;
}

std::string renderJson1(XlatorInterface& translator, int32_t code,
                        const rapidjson::Value* description, const Json1Request& request) {
  std::string text = translator.getStaticDesc(code, request.language, request.ade);
  if (description == nullptr || !description->IsObject()) return trimLineBreaks(std::move(text));

  bool debug = request.debug || asksForDebug(*description);
  try {
    std::string dynamicJson = translator.getDynamicDesc(toJson(*description), request.language,
                                                        request.ade, request.format);
    text += "\n\n";
    text += formatDynamicItems(dynamicJson, debug);
  } catch (TranslationFailure& failure) {
    // The static description stands even when the details cannot be shown.
    if (!failure.partialText().empty()) throw;
    TranslationFailure withText(failure.code(), failure.what(), trimLineBreaks(text));
    withText.status() = failure.status();
    throw withText;
  }
  text = trimLineBreaks(std::move(text));

  auto nested = description->FindMember("nested_error");
  if (nested != description->MemberEnd()) {
    if (!nested->value.IsArray()) throw TranslationFailure(kCodeInternal, kNestedNotArray, text);
    for (const auto& element : nested->value.GetArray()) {
      if (!element.IsObject() || !element.HasMember("code") || !element["code"].IsInt()) {
        throw TranslationFailure(kCodeInternal, kNestedElementInvalid, text);
      }
      auto nestedCode = element.FindMember("code");
      std::string block;
      try {
        block = renderJson1(translator, nestedCode->value.GetInt(), &element, request);
      } catch (TranslationFailure& failure) {
        // What was rendered of the outer error stands.
        TranslationFailure withText(failure.code(), failure.what(), text);
        withText.status() = failure.status();
        throw withText;
      }
      text += "\n\n";
      text += indent(block);
    }
  }
  return trimLineBreaks(std::move(text));
}

}  // namespace hsdig::translator
