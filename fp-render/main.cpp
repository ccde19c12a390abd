#include <cstddef>
#include <iostream>
#include <span>

#include "fp-render/render.h"

int main(int argc, char** argv) {
  // A program may be started without even its own name.
  const std::span<const char* const> arguments(argv, static_cast<std::size_t>(argc));
  return frontpanels::render(arguments.subspan(arguments.empty() ? 0 : 1), frontpanels::systemTextFiles(),
                             std::cout, std::cerr);
}
