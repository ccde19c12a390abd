// What a panel is handed at its creation: the outside, one narrow interface a thing, and the ambient facts.
#pragma once

#include <string>

#include "platform/data_server.h"
#include "platform/gdi.h"
#include "platform/windowing.h"

namespace frontpanels {

// Everything referred to must outlive the panel.
struct PanelEnvironment {
  Gdi& gdi;
  Windowing& windowing;
  GraphView& view;  // the picture box of the panel's graph
  DataHub& hub;
  ScreenMetrics metrics;
  std::string commandLine;  // of the host's process: chooses the label style
};

}  // namespace frontpanels
