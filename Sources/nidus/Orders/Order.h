#pragma once

#include <string>
#include <vector>

#include "AssistantHost/CommandReader.h"
#include "HomePlatform/Metadata/Vocabulary.h"
#include "HomePlatform/Result.h"

namespace nidus {

/// Which objects of the home an order is for, in a person's words. An empty text is a field that
/// was not given.
struct OrderFilter {
  std::string home;
  std::string room;
  std::string zone;
  std::string group;
  std::string service;
  std::string scene;
  std::string type;    ///< A service type, in either case: "light".
  std::string entity;  ///< An entity type, in either case: "room".
};

/// An order as a person writes it, such as `set brightness 40% --room Kitchen`.
struct OrderWords {
  std::string verb;                ///< "get", "set", "raise", "lower", "toggle", "limits" or "run".
  std::vector<std::string> words;  ///< What follows the verb: "brightness", "40%".
  OrderFilter filter;
  bool asksTarget = false;  ///< Asks for the value that was set, not for the one that is.
};

/// An order that the plug-in can do.
struct Order {
  enum class Kind {
    get,     ///< What is the value?
    ask,     ///< Which objects have this value?
    set,     ///< To a value, or to its minimum or maximum.
    raise,   ///< Relative to what it is.
    lower,   ///< Relative to what it is.
    toggle,  ///< On or off, whatever it was not.
    limits,  ///< Minimum, maximum and step, by one command each, in this order.
    run,     ///< A scene.
  };
  Kind kind = Kind::get;
  std::string attribute;  ///< The assistant's name; empty: only which objects.
  /// One, but for limits, and for a minimum or maximum that is not the same for all objects; none
  /// is null.
  std::vector<CommandRef> commands;
};

/// Turns a person's words into commands. `isMetric` is the metric flag of the device. An order to a
/// minimum or maximum has no value yet (see `withLimitValues`). A failure is bad input and names
/// the word, with a near miss where there is one.
[[nodiscard]] Result<Order> readOrder(const OrderWords& order, const Vocabulary& vocabulary,
                                      bool isMetric);

}  // namespace nidus
