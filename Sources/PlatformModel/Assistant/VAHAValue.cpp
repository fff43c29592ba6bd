#include "PlatformModel/Assistant/VAHAValue.h"

#include "PlatformModel/System/NDNumberText.h"

namespace nidus {
namespace {

template <class Value>
bool isOfClass(const VAHAValue* value) {
  return dynamic_cast<const Value*>(value) != nullptr;
}

}  // namespace

VAHAValue::~VAHAValue() = default;

NDDictionary VAHAValue::dictionary() const {
  NDDictionary form;
  form.reserve(units_ ? 2 : 1);
  addValue(form);
  form.setIfPresent("units", units_);
  return form;
}

std::shared_ptr<VAHABooleanValue> VAHABooleanValue::booleanValue() {
  return std::make_shared<VAHABooleanValue>();
}

bool VAHABooleanValue::isClassOf(const VAHAValue* other) const {
  return isOfClass<VAHABooleanValue>(other);
}

std::string VAHABooleanValue::description() const { return value_ ? "1" : "0"; }

void VAHABooleanValue::addValue(NDDictionary& dictionary) const {
  dictionary.set("boolean", NDDictionaryValue(value_));
}

std::shared_ptr<VAHAIntegerValue> VAHAIntegerValue::integerValue() {
  return std::make_shared<VAHAIntegerValue>();
}

bool VAHAIntegerValue::isClassOf(const VAHAValue* other) const {
  return isOfClass<VAHAIntegerValue>(other);
}

std::string VAHAIntegerValue::description() const { return numberText(value_); }

void VAHAIntegerValue::addValue(NDDictionary& dictionary) const {
  dictionary.set("integer", NDDictionaryValue(value_));
}

std::shared_ptr<VAHAFloatValue> VAHAFloatValue::floatValue() {
  return std::make_shared<VAHAFloatValue>();
}

bool VAHAFloatValue::isClassOf(const VAHAValue* other) const {
  return isOfClass<VAHAFloatValue>(other);
}

std::string VAHAFloatValue::description() const { return numberText(value_); }

void VAHAFloatValue::addValue(NDDictionary& dictionary) const {
  dictionary.set("float", NDDictionaryValue(value_));
}

std::shared_ptr<VAHAStringValue> VAHAStringValue::stringValue() {
  return std::make_shared<VAHAStringValue>();
}

bool VAHAStringValue::isClassOf(const VAHAValue* other) const {
  return isOfClass<VAHAStringValue>(other);
}

std::string VAHAStringValue::description() const { return value_ ? value_.str() : "(null)"; }

void VAHAStringValue::addValue(NDDictionary& dictionary) const {
  dictionary.set("string", NDDictionaryValue(value_));
}

}  // namespace nidus
