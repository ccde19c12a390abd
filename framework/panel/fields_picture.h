// A panel's fields as a picture, for where there are no windows of theirs: on a form that is being designed,
// on paper, in a metafile. They look as the system draws them, without anything that only a user needs: no
// focus, no selection, no underlined keys.
#pragma once

#include <functional>

#include "platform/control_set.h"

namespace frontpanels {

// The font of a field is its owner's.
using FieldFont = std::function<FontHandle(const Control&)>;

// Draws the controls of the set that are to be seen in a view of this size, places scaled to dots an inch.
void paintFields(Gdi& gdi, DcHandle dc, const ControlSet& controls, Size viewPx, std::int32_t dpi,
                 const FieldFont& fontOf);

}  // namespace frontpanels
