// The Qt application of the tests that need one.
#pragma once

/// Makes the application on first use; the picture writer is tested without it too.
void NeedApp();
