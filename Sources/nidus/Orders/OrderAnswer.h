#pragma once

#include "nidus/ExitStatus.h"
#include "nidus/Orders/Order.h"
#include "nidus/Session.h"

namespace nidus {

/// How an answer is shown.
enum class AnswerForm {
  table,  ///< For people.
  json,   ///< The replies themselves, one a line.
  quiet,  ///< Not at all: the exit status tells.
};

/// Reads and performs an order and shows its answer on standard output; a failure, and silence, are
/// reported.
ExitStatus answerOrder(Session& session, const OrderWords& words, AnswerForm form);

}  // namespace nidus
