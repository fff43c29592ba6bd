#include "PlatformModel/System/NDURL.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <stdexcept>

namespace nidus {
namespace {

using testing::ElementsAre;
using testing::IsEmpty;

TEST(NDURLTest, BuildsTextFromThreeParts) {
  const NDURL url = NDURL::make("x-corvane-nidus", "local", "/home?id=1&x=%20 \u00E9");
  EXPECT_EQ(url.text(), "x-corvane-nidus://local/home?id=1&x=%20 \u00E9");
}

TEST(NDURLTest, EachCallGivesNewObject) {
  const NDURL a = NDURL::make("s", "h", "/p");
  const NDURL b = NDURL::make("s", "h", "/p");
  EXPECT_NE(a.text().view().data(), b.text().view().data());
  EXPECT_EQ(a, b);
}

TEST(NDURLTest, FromTextKeepsText) {
  const NDString text = "not a URL";
  EXPECT_EQ(NDURL::fromText(text).text().view().data(), text.view().data());
}

TEST(NDURLTest, MayBeNull) {
  EXPECT_FALSE(NDURL());
  EXPECT_FALSE(NDURL(nullptr));
  EXPECT_FALSE(NDURL::fromText(nullptr));
  EXPECT_FALSE(NDURL().text());
  EXPECT_EQ(NDURL(), NDURL(nullptr));
  EXPECT_TRUE(NDURL::fromText(""));
  EXPECT_FALSE(NDURL() == NDURL::fromText(""));
}

TEST(NDURLTest, EqualsByItsText) {
  EXPECT_EQ(NDURL::fromText("s://h/p"), NDURL::make("s", "h", "/p"));
  EXPECT_FALSE(NDURL::fromText("s://h/p") == NDURL::make("s", "h", "/P"));
}

struct Parts {
  const char* text;
  NDString scheme;
  std::vector<NDString> components;
  NDString query;
};

std::vector<Parts> parts() {
  return {
      {"x-corvane-nidus://local/home?id=1", "x-corvane-nidus", {"/", "home"}, "id=1"},
      {"s://h/service?id=12&accessory=A&home=H", "s", {"/", "service"}, "id=12&accessory=A&home=H"},
      {"s://h/a/b/?q", "s", {"/", "a", "b"}, "q"},
      {"s://h//a", "s", {"/", "a"}, nullptr},
      {"s://h/", "s", {"/"}, nullptr},
      {"s://h", "s", {}, nullptr},
      {"s://h?q/r", "s", {}, "q/r"},
      {"s://h#f?g", "s", {}, nullptr},
      {"s://h/a#f?g", "s", {"/", "a"}, nullptr},
      {"s://h/a?q#f", "s", {"/", "a"}, "q"},
      {"s://h/a?q?r", "s", {"/", "a"}, "q?r"},
      {"s://h/a?", "s", {"/", "a"}, ""},
      {"s:/a/b", "s", {"/", "a", "b"}, nullptr},
      {"s:a", "s", {"a"}, nullptr},
      {":", "", {}, nullptr},
      {"/home?id=1:2", nullptr, {"/", "home"}, "id=1:2"},
      {"//h/a", nullptr, {"/", "a"}, nullptr},
      {"text", nullptr, {"text"}, nullptr},
      {"", nullptr, {}, nullptr},
  };
}

TEST(NDURLTest, ReadsSchemePathAndQuery) {
  for (const Parts& expected : parts()) {
    SCOPED_TRACE(expected.text);
    const NDURL url = NDURL::fromText(expected.text);
    EXPECT_EQ(url.scheme(), expected.scheme);
    EXPECT_EQ(url.pathComponents(), expected.components);
    EXPECT_EQ(url.query(), expected.query);
  }
}

TEST(NDURLTest, ComponentsAreReadOneByOne) {
  for (const Parts& expected : parts()) {
    SCOPED_TRACE(expected.text);
    const NDURL url = NDURL::fromText(expected.text);
    const std::size_t count = expected.components.size();
    for (std::size_t i = 0; i < count; ++i) {
      EXPECT_EQ(url.pathComponent(i), expected.components[i].view());
    }
    EXPECT_THROW((void)url.pathComponent(count), std::out_of_range);
    EXPECT_THROW((void)url.pathComponent(count + 1), std::out_of_range);
  }
}

TEST(NDURLTest, ViewsLieInTheText) {
  const NDURL url = NDURL::fromText("s://h/room?id=1#f");
  const char* const text = url.text().view().data();
  EXPECT_EQ(url.pathComponent(1).data(), text + 6);
  ASSERT_TRUE(url.queryView());
  EXPECT_EQ(url.queryView()->data(), text + 11);
  EXPECT_EQ(url.queryView(), "id=1");
  EXPECT_FALSE(NDURL::fromText("s://h#?").queryView());
}

TEST(NDURLTest, AnyTextIsRead) {
  EXPECT_THAT(NDURL::fromText("#").pathComponents(), IsEmpty());
  EXPECT_THAT(NDURL::fromText("s:///p").pathComponents(), ElementsAre(NDString("/"), "p"));
}

}  // namespace
}  // namespace nidus
