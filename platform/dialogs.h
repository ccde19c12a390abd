// What interrupts the user, and how the user interrupts.
#pragma once

#include <optional>
#include <string>
#include <string_view>

namespace frontpanels {

class Dialogs {
 public:
  virtual ~Dialogs() = default;

  // A modal box with only an OK button and the default title. May raise nothing and lose nothing: where no
  // box can be shown, the text goes to wherever the program keeps its messages.
  virtual void messageBox(std::string_view text) noexcept = 0;
};

class FileDialogs {
 public:
  virtual ~FileDialogs() = default;

  // The path (UTF-8) of an existing file that the user chooses; none when he cancels. `filter` is pairs of a
  // name and its patterns: "Text Files (*.txt)|*.txt"; an empty one shows all files. Raises "Invalid
  // procedure call or argument" for half a pair and "Out of memory" when the window system refuses.
  [[nodiscard]] virtual std::optional<std::string> openFile(std::string_view filter) = 0;

  // For a long task on the user-interface thread, asked now and then: whether the user has pressed Escape.
  // The press is used up; everything else that waits for the program goes on waiting.
  [[nodiscard]] virtual bool cancelPressed() noexcept = 0;
};

}  // namespace frontpanels
