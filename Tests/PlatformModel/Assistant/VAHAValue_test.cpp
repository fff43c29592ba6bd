#include "PlatformModel/Assistant/VAHAValue.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <vector>

namespace nidus {
namespace {

template <class Class, class Value>
std::shared_ptr<Class> filled(std::shared_ptr<Class> object, Value value) {
  object->setValue(std::move(value));
  return object;
}

NDDictionary dictionaryOf(std::string_view key, NDDictionaryValue value) {
  NDDictionary dictionary;
  dictionary.set(key, std::move(value));
  return dictionary;
}

TEST(VAHAValueTest, NewValuesAreNeutral) {
  EXPECT_FALSE(VAHABooleanValue::booleanValue()->value());
  EXPECT_EQ(VAHAIntegerValue::integerValue()->value(), 0);
  EXPECT_EQ(VAHAFloatValue::floatValue()->value(), 0.0F);
  EXPECT_FALSE(VAHAStringValue::stringValue()->value());
  EXPECT_FALSE(VAHABooleanValue::booleanValue()->units());
}

struct Form {
  const char* label;
  VAHAValueRef value;
  NDDictionary dictionary;
  std::string description;
};

std::vector<Form> forms() {
  return {
      {"boolean", filled(VAHABooleanValue::booleanValue(), true),
       dictionaryOf("boolean", NDDictionaryValue(true)), "1"},
      {"false", filled(VAHABooleanValue::booleanValue(), false),
       dictionaryOf("boolean", NDDictionaryValue(false)), "0"},
      {"integer", filled(VAHAIntegerValue::integerValue(), -5),
       dictionaryOf("integer", NDDictionaryValue(std::int64_t{-5})), "-5"},
      {"float", filled(VAHAFloatValue::floatValue(), 21.5F),
       dictionaryOf("float", NDDictionaryValue(21.5F)), "21.5"},
      {"string", filled(VAHAStringValue::stringValue(), NDString("HEAT")),
       dictionaryOf("string", NDDictionaryValue(NDString("HEAT"))), "HEAT"},
      {"empty string", filled(VAHAStringValue::stringValue(), NDString("")),
       dictionaryOf("string", NDDictionaryValue(NDString(""))), ""},
      {"no string", VAHAStringValue::stringValue(), dictionaryOf("string", NDDictionaryValue()),
       "(null)"},
  };
}

TEST(VAHAValueTest, HasPlainFormAndDescription) {
  for (const Form& form : forms()) {
    SCOPED_TRACE(form.label);
    EXPECT_EQ(form.value->dictionary(), form.dictionary);
    EXPECT_EQ(form.value->description(), form.description);
  }
}

TEST(VAHAValueTest, UnitsStandBehindTheValue) {
  const auto value = filled(VAHAFloatValue::floatValue(), 21.5F);
  value->setUnits("CELSIUS");
  NDDictionary expected = dictionaryOf("float", NDDictionaryValue(21.5F));
  expected.set("units", NDDictionaryValue(NDString("CELSIUS")));
  EXPECT_EQ(value->dictionary(), expected);
  EXPECT_EQ(value->description(), "21.5");
}

TEST(VAHAValueTest, IsClassOfTellsClassesApart) {
  const std::vector<VAHAValueRef> values = {
      VAHABooleanValue::booleanValue(), VAHAIntegerValue::integerValue(),
      VAHAFloatValue::floatValue(), VAHAStringValue::stringValue()};
  for (std::size_t a = 0; a < values.size(); ++a) {
    for (std::size_t b = 0; b < values.size(); ++b) {
      EXPECT_EQ(values[a]->isClassOf(values[b].get()), a == b) << a << ' ' << b;
    }
    EXPECT_FALSE(values[a]->isClassOf(nullptr));
  }
}

TEST(VAHAValueTest, IsClassOfTakesDerivedClasses) {
  class Level : public VAHAIntegerValue {};
  const Level level;
  EXPECT_TRUE(VAHAIntegerValue::integerValue()->isClassOf(&level));
  EXPECT_FALSE(VAHAFloatValue::floatValue()->isClassOf(&level));
}

}  // namespace
}  // namespace nidus
