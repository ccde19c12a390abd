// What all panels of the process share: the graphics interface, window services, the data hub, the message
// boxes.
#pragma once

#include "activex/message_boxes.h"
#include "platform/data_server.h"
#include "platform/win32/win32_gdi.h"
#include "platform/win32/win32_windowing.h"

namespace frontpanels::activex {

struct Services {
  Win32Gdi gdi;
  Win32Windowing windowing;
  MessageBoxes dialogs;
  DataHub hub;
};
// Made with the first object that needs it; connects the error reporter to message boxes.
[[nodiscard]] Services& services();

}  // namespace frontpanels::activex
