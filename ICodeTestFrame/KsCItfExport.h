// The module's only exported classes carry this; everything else stays inside the module.
#pragma once

#define ITF_EXPORT __attribute__((visibility("default")))
