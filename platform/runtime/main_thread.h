// The guard at the head of every window, control and message operation: they belong to the
// application's main thread alone.
#pragma once

// Raises ThreadAccessingUIException when called on any other thread.
void RequireMainThread();
