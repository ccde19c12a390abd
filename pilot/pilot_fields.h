// All fields of Tarvex: the controls of the designer table and the entries and lists that give them their
// meaning.
#pragma once

#include <cstdint>

#include "entry/enumerated_parameter.h"
#include "entry/numeric_entry.h"
#include "pilot/code_entries.h"
#include "pilot/user_pn_list.h"
#include "platform/control_set.h"

namespace frontpanels {

class PilotFields {
 public:
  // The controls are those of pilotControls and must outlive the fields.
  explicit PilotFields(ControlSet& ofPanel);

  ControlSet& controls;
  CodeEntries code;
  UserPnList userPnList;
  clsNumericEntry topN;              // bars
  clsNumericEntry threshold;         // in the unit of the bars; blank while there is none
  clsNumericEntry carrierFrequency;  // Hz
  clsNumericEntry io;                // dBm, shown only
  clsNumericEntry verticalScale;     // dB a division
  clsNumericEntry verticalOffset;    // level at the top of the graph
  clsEnumeratedParameter format;
  clsEnumeratedParameter channelization;
  clsEnumeratedParameter sortBy;
  clsEnumeratedParameter barLabel;
  clsEnumeratedParameter barChartStyle;
  clsEnumeratedParameter powerDisplay;

  // Code positions are shown anew, in the chosen units of the chosen format.
  void showCodeUnits();
  // The quantities that can be shown beside a bar: those of multipath records, or fewer. False, and nothing
  // is changed, where the list does not hold what it should.
  [[nodiscard]] bool barLabelsForMultipath(bool multipath);
  // The list's fields can be used while the user's list is on. Without a selection there is nothing to
  // delete.
  void enableUserPnList(bool enable);
  void updateDeleteButton();
  // Fields that only bars go by.
  void enableBarFields(bool enable);

 private:
  void setUpEntries();
  void setUpLists();

  bool userPnListEnabled_ = false;
};

}  // namespace frontpanels
