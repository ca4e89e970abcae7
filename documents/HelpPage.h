#pragma once

// Writes to `path` (replacing any file there) the HTML page that explains every
// registered message type, in registration order: an anchor named after its
// code, its full name and its help text as live HTML. Returns 0; when the page
// cannot be opened, writes "Unable to open file " and the path to the error
// log stream, and when it cannot be written or closed, an "ERROR: " line with
// the path and the system's reason; both return non-zero.
int WriteHelpFile(const char* path);
