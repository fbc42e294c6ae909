#include "KsCHostOptions.h"

KS_Options::~KS_Options() = default;
KS_OptionsExt::~KS_OptionsExt() = default;
