// The shared library's own translation unit; the module's code comes from its static archive.
#include "ItfControl/KsCItfControlIF.h"
