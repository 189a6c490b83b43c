#pragma once
// Copy, Cut and Paste items of an Edit menu ("copymen", "cutmen",
// "pastemen"): they act on the line or text box that has the focus, and are
// enabled, each time the menu opens, as far as that box allows (a selection to
// copy, an editable box to cut from or paste into, text on the clipboard).

class QMenu;

namespace qm {

void addclipboarditems(QMenu* menu);

} // namespace qm
