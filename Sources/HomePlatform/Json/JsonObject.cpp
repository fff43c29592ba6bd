#include "HomePlatform/Json/JsonObject.h"

#include <algorithm>

#include "HomePlatform/Json/JsonPath.h"

namespace nidus {

void JsonPlaced::fail(const std::string& message) const { throw JsonError{place_, message}; }

bool JsonPlaced::isNull() const { return std::holds_alternative<std::nullptr_t>(value_->content); }

bool JsonPlaced::boolean() const {
  const auto* boolean = std::get_if<bool>(&value_->content);
  if (!boolean) fail("expected true or false");
  return *boolean;
}

std::int64_t JsonPlaced::integer(std::int64_t least, std::int64_t greatest) const {
  const auto* number = std::get_if<std::int64_t>(&value_->content);
  if (!number || *number < least || *number > greatest) {
    fail("expected an integer from " + std::to_string(least) + " to " + std::to_string(greatest));
  }
  return *number;
}

const std::string& JsonPlaced::text() const {
  const auto* text = std::get_if<std::string>(&value_->content);
  if (!text) fail("expected a text");
  return *text;
}

NDUUID JsonPlaced::uuid() const {
  const auto* text = std::get_if<std::string>(&value_->content);
  const auto uuid = text ? NDUUID::fromText(*text) : std::nullopt;
  if (!uuid) fail("expected a UUID such as \"9E01A3C4-0000-4000-8000-000000000001\"");
  return *uuid;
}

NDValueRef JsonPlaced::boxed() const {
  if (const auto* boolean = std::get_if<bool>(&value_->content)) return NDValue::boolean(*boolean);
  if (const auto* integer = std::get_if<std::int64_t>(&value_->content)) {
    return NDValue::integer(*integer);
  }
  if (const auto* number = std::get_if<float>(&value_->content)) return NDValue::floating(*number);
  if (const auto* text = std::get_if<std::string>(&value_->content)) {
    return NDValue::text(NDString(*text));
  }
  fail("expected true, false, a number or a text");
}

std::vector<JsonPlaced> JsonPlaced::array() const {
  const auto* elements = std::get_if<JsonValue::Array>(&value_->content);
  if (!elements) fail("expected an array");
  std::vector<JsonPlaced> placed;
  placed.reserve(elements->size());
  for (const JsonValue& element : *elements) {
    placed.emplace_back(element, place_ + '/' + std::to_string(placed.size()));
  }
  return placed;
}

JsonObject::JsonObject(JsonPlaced object)
    : object_(std::move(object)),
      members_(std::get_if<JsonValue::Object>(&object_.value().content)) {
  if (!members_) object_.fail("expected an object");
}

JsonPlaced JsonObject::required(std::string_view key) {
  allow(key);
  const JsonValue* value = find(key);
  if (!value) object_.fail("missing required key \"" + std::string(key) + '"');
  return placedAt(key, *value);
}

std::optional<JsonPlaced> JsonObject::optional(std::string_view key) {
  allow(key);
  const JsonValue* value = find(key);
  if (!value || std::holds_alternative<std::nullptr_t>(value->content)) return std::nullopt;
  return placedAt(key, *value);
}

void JsonObject::allow(std::string_view key) {
  if (std::find(known_.begin(), known_.end(), key) == known_.end()) known_.push_back(key);
}

void JsonObject::refuseUnknownKeys() const {
  for (const auto& [key, value] : *members_) {
    if (std::find(known_.begin(), known_.end(), key) != known_.end()) continue;
    std::string message = "no such key; expected one of ";
    for (const std::string_view known : known_) {
      if (known != known_.front()) message += ", ";
      message += known;
    }
    placedAt(key, value).fail(known_.empty() ? "no such key; expected none" : message);
  }
}

const JsonValue* JsonObject::find(std::string_view key) const {
  for (const auto& [name, value] : *members_) {
    if (name == key) return &value;
  }
  return nullptr;
}

JsonPlaced JsonObject::placedAt(std::string_view key, const JsonValue& value) const {
  std::string place = object_.place();
  appendPointerStep(place, key);
  return {value, std::move(place)};
}

}  // namespace nidus
