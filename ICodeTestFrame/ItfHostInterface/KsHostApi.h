// Visibility of the host code generator's classes as the module sees them: they live in the
// host's own libraries, so the module refers to them with default visibility even though it
// hides everything of its own.
#pragma once

#define KS_HOST_API __attribute__((visibility("default")))
