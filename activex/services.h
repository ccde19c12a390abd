// What all panels of the process share: the graphics interface, window services, the data hub, the boxes, the
// user's separators.
#pragma once

#include "activex/message_boxes.h"
#include "framework/support/utility.h"
#include "platform/data_server.h"
#include "platform/win32/picture_gdi.h"
#include "platform/win32/win32_locale.h"
#include "platform/win32/win32_windowing.h"

namespace frontpanels::activex {

struct Services {
  PictureGdi gdi;
  Win32Windowing windowing;
  MessageBoxes dialogs;
  FileBoxes fileDialogs;
  DataHub hub;
  Win32Locale locale;
  RegionalSeparators separators{locale};
};
// Made with the first object that needs it; connects the error reporter to message boxes.
[[nodiscard]] Services& services();

}  // namespace frontpanels::activex
