// The user's PN list on Tarvex: edits of the user and of the host, import of a text file.
#include "framework/support/error_handler.h"
#include "framework/support/flag_scope.h"
#include "framework/support/guard.h"
#include "framework/support/host_codes.h"
#include "pilot/import_list_parser.h"
#include "pilot/tarvex.h"
#include "platform/runtime_error.h"

namespace frontpanels {
namespace {

constexpr const char* kImportFilter = "Text Files (*.txt)|*.txt";
// Lines between two looks at the keyboard.
constexpr std::size_t kLinesPerLook = 256;

std::int16_t indexToDelete(std::int32_t position) { return static_cast<std::int16_t>(-1 - position); }

}  // namespace

// --- Edits

// A host that echoes an edit while it is told of it changes nothing a second time.
void Tarvex::setUserPn(std::int16_t index, const Variant& value) {
  if (editWithHost_ != nullptr && editWithHost_->index == index && editWithHost_->pn == value.toDouble())
    return;
  if (!fields_.userPnList.edit(index, value)) return;
  if (index < 0) userPnListChanged();
  fields_.updateDeleteButton();
}

bool Tarvex::tellHostOfPn(std::string_view routine, const PnEdit& edit) {
  const ValueScope telling(editWithHost_, &edit);
  return request(routine, CDMA_CODE_OFFSET, edit.index, static_cast<double>(edit.pn));
}

// An item that the host has refused. It may have edited the list before it did so.
void Tarvex::takeBack(std::int32_t position, std::int32_t pn) {
  UserPnList& list = fields_.userPnList;
  if (position < list.count() && list.pn(position) == pn) list.remove(position);
}

void Tarvex::userPNListAddButton_Click() {
  guard("Tarvex::userPNListAddButton_Click()", [this] {
    UserPnList& list = fields_.userPnList;
    // A text that was refused when the field was left: the number that is back is not what was meant.
    if (!list.entry.validNumeric()) return list.entry.validNumeric(true);
    const std::int32_t position = list.count();
    const auto pn = static_cast<std::int32_t>(list.entry.value());
    if (position >= UserPnList::kMostItems) raiseOverflow();
    list.append(pn);
    if (!tellHostOfPn("userPNListAddButton_Click()", {static_cast<std::int16_t>(position), pn}))
      takeBack(position, pn);
    fields_.updateDeleteButton();
  });
}

void Tarvex::userPNListDeleteButton() {
  guard("Tarvex::userPNListDeleteButton()", [this] {
    UserPnList& list = fields_.userPnList;
    const std::int32_t position = list.selected();
    if (position < 0) return;
    const std::int32_t pn = list.pn(position);
    if (!tellHostOfPn("userPNListDeleteButton()", {indexToDelete(position), pn})) return;
    takeBack(position, pn);
    userPnListChanged();
    fields_.updateDeleteButton();
  });
}

void Tarvex::userPNListListBox_Click() { fields_.updateDeleteButton(); }

void Tarvex::userPnListChanged() {
  if (clsBarChartPainter* const bars = userListBars()) bars->dataChanged(true);
}

// --- Import

void Tarvex::userPNListImportButton() {
  guard("Tarvex::userPNListImportButton()", [this] {
    const std::optional<std::string> path = services_.fileDialogs.openFile(kImportFilter);
    if (!path || base().closing()) return;
    if (const std::optional<std::vector<std::int32_t>> pns = readPnFile(*path)) importPns(*pns);
    fields_.updateDeleteButton();
  });
}

// The PN offsets of the file's lines up to the first one without any; nothing when the user has cancelled.
// The file is read whole before the list is touched: one that cannot be used changes nothing.
std::optional<std::vector<std::int32_t>> Tarvex::readPnFile(const std::string& path) {
  const UserPnList& list = fields_.userPnList;
  ImportListParser parser(services_.textFiles, services_.separators);
  parser.FileOpen(path);
  std::vector<std::int32_t> pns;
  while (parser.ParseEntry()) {
    if (pns.size() % kLinesPerLook == kLinesPerLook - 1 && services_.fileDialogs.cancelPressed())
      return std::nullopt;
    const std::optional<std::int32_t> pn = list.read(parser.GetArg(0));
    if (!pn) raiseTypeMismatch();
    if (list.count() + static_cast<std::int32_t>(pns.size()) >= UserPnList::kMostItems) raiseOverflow();
    pns.push_back(*pn);
  }
  return pns;
}

// A host that refuses one, and a user who cancels, end it with the lines before.
void Tarvex::importPns(std::span<const std::int32_t> pns) {
  UserPnList& list = fields_.userPnList;
  for (std::size_t i = 0; i < pns.size(); ++i) {
    if (i % kLinesPerLook == kLinesPerLook - 1 && services_.fileDialogs.cancelPressed()) break;
    const std::int32_t position = list.count();
    list.append(pns[i]);
    if (tellHostOfPn("userPNListImportButton()", {static_cast<std::int16_t>(position), pns[i]})) continue;
    takeBack(position, pns[i]);
    break;
  }
  request("userPNListImportButton()", kPnIncrementParameter, fields_.code.pnIncrement.value());
}

}  // namespace frontpanels
