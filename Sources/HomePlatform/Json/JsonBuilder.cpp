#include "HomePlatform/Json/JsonBuilder.h"

#include <utility>

namespace nidus {

void JsonBuilder::scalar(JsonValue value, const JsonPath& path) {
  countValue(path);
  place(std::move(value));
}

void JsonBuilder::beginObject(const JsonPath& path) {
  countValue(path);
  open_.push_back({JsonValue::Object()});
  keys_.emplace_back();
}

void JsonBuilder::key(std::string_view key, const JsonPath& /*path*/) { keys_.back() = key; }

void JsonBuilder::endObject(const JsonPath& /*path*/) { close(); }

void JsonBuilder::beginArray(const JsonPath& path) {
  countValue(path);
  open_.push_back({JsonValue::Array()});
  keys_.emplace_back();
}

void JsonBuilder::endArray(const JsonPath& /*path*/) { close(); }

JsonValue JsonBuilder::take() {
  isComplete_ = false;
  return std::exchange(root_, {});
}

void JsonBuilder::countValue(const JsonPath& path) {
  if (++count_ > maximumValues_) {
    throw JsonError{path.place(),
                    "there are more than " + std::to_string(maximumValues_) + " values here"};
  }
}

void JsonBuilder::place(JsonValue value) {
  if (open_.empty()) {
    root_ = std::move(value);
    isComplete_ = true;
  } else if (auto* object = std::get_if<JsonValue::Object>(&open_.back().content)) {
    object->emplace_back(std::move(keys_.back()), std::move(value));
  } else {
    std::get<JsonValue::Array>(open_.back().content).push_back(std::move(value));
  }
}

void JsonBuilder::close() {
  JsonValue value = std::move(open_.back());
  open_.pop_back();
  keys_.pop_back();
  place(std::move(value));
}

}  // namespace nidus
