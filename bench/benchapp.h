// The Qt application of the benchmarks that need one, without a screen.
#pragma once

/// Makes it with the first call.
void NeedBenchApp();

/// Ends it, before the libraries that it uses go; windows must be gone by then.
void EndBenchApp();
