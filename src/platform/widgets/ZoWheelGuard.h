// Rolling the mouse wheel over a form scrolls the form: drop-down lists, spin boxes and
// sliders change their value by the wheel only while they have the keyboard focus, so that
// scrolling past a field never edits the setup by accident.
#pragma once

// Installs the guard once for the whole application (later calls do nothing). Needs a
// QApplication.
void ZoInstallWheelGuard();
