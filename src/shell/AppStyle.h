#pragma once

class QApplication;

namespace verbloom {

/// The program's look: the Fusion style, a light palette, the program icon and one style sheet
/// for all windows.
void ApplyAppStyle(QApplication &app);

} // namespace verbloom
