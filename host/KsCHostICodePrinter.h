// Shows what a run left in the code model: a readable, C-like listing of every host file with
// its symbols and functions, and the same content as JSON. Same model, same bytes.
#pragma once

#include "ItfHostInterface/KsHostApi.h"

#include <string>

class KsCHostCodeModel;

class KS_HOST_API KsCHostICodePrinter {
public:
    // The listing (docs/icode-listing.md); empty when the model holds no file.
    static std::string listing(const KsCHostCodeModel& model);
    // The value of the report's "icode" key as JSON text: {"files": [...]}.
    static std::string json(const KsCHostCodeModel& model);
};
