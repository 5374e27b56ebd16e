#pragma once

// Loads the control library as the application does: ORBANE_CONTROLS, else
// <bench dir>/../lib/orbane/liborbanecontrols.so, symbols global. Once per process.
bool LoadControlModule();
