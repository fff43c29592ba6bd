#include "PlatformModel/Assistant/VAHAFilter.h"

#include "PlatformModel/Assistant/VAHAConstants.h"
#include "PlatformModel/System/NDOneLine.h"

namespace nidus {
namespace {

/// Collects the fields of a filter on one line: `NAME {homeName: "Cabin", roomName: "Hall"}`.
class FilterText {
 public:
  explicit FilterText(std::string_view className) : text_(className) { text_ += " {"; }

  void add(std::string_view field, const NDString& value) {
    if (!value) return;
    separate();
    text_.append(field).append(": ");
    addQuoted(value.view());
  }

  void add(const NDURL& identifier) {
    separate();
    addQuoted(identifier.text().view());
  }

  [[nodiscard]] std::string finish() { return std::move(text_) + '}'; }

 private:
  void separate() {
    if (!text_.ends_with('{')) text_ += ", ";
  }

  void addQuoted(std::string_view value) {
    text_ += '"';
    appendOnOneLine(text_, value, "\"");
    text_ += '"';
  }

  std::string text_;
};

}  // namespace

VAHAFilter::~VAHAFilter() = default;

std::string_view VAHASearchCriteriaFilter::encodedClassName() const {
  return VAHASearchCriteriaFilterClassIdentifier;
}

std::string VAHASearchCriteriaFilter::description() const {
  FilterText text(encodedClassName());
  text.add("homeName", homeName_);
  text.add("entityType", entityType_);
  text.add("attribute", attribute_);
  text.add("serviceType", serviceType_);
  text.add("roomName", roomName_);
  text.add("zoneName", zoneName_);
  text.add("groupName", groupName_);
  text.add("serviceName", serviceName_);
  text.add("sceneName", sceneName_);
  return text.finish();
}

std::string_view VAHAIdentifierFilter::encodedClassName() const {
  return VAHAIdentifierFilterClassIdentifier;
}

std::string VAHAIdentifierFilter::description() const {
  FilterText text(encodedClassName());
  for (const NDURL& identifier : identifiers_) text.add(identifier);
  return text.finish();
}

}  // namespace nidus
