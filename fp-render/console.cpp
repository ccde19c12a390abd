#include "fp-render/console.h"

#include <algorithm>

#include "framework/support/error_handler.h"

namespace frontpanels {

// Lines of reports end with a carriage return.
void Console::reportsOfPanel() {
  for (std::string message : messageLog().messages()) {
    std::replace(message.begin(), message.end(), '\r', ' ');
    problem("fp-render: the panel reports: " + message);
  }
  messageLog().clear();
}

void Console::finish() {
  output_.flush();
  if (!output_) problem("fp-render: standard output: cannot be written");
}

}  // namespace frontpanels
