#pragma once
// How long ago this process started, as the kernel counts it: the start-to-first-window figure
// includes the loader's work before main.

namespace kg::demo {

// Milliseconds since the process was started; 0 when the system does not say.
double millisecondsSinceStart();

}  // namespace kg::demo
