#pragma once
// The details of the chosen image, as the image dialogs show them: five
// read-only fields under their captions, then the preview with its hint.

#include <array>
#include <span>

class QLineEdit;
class QVBoxLayout;
class QWidget;

namespace qm {

class imagepreview;
class prompts;

// Adds the fields (named Imageinfotxt0..4, captions in the dialog's own order)
// and the preview to `layout`, a layout of `frame`; returns the preview.
imagepreview* addimagedetails(QWidget* frame, QVBoxLayout* layout, const std::array<const char*, 5>& captions,
                              std::span<QLineEdit*, 5> fields, prompts& p);

} // namespace qm
