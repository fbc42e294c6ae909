#include "KsCHostICodePrinter.h"

#include "KsCHostCodeModel.h"

std::string KsCHostICodePrinter::listing(const KsCHostCodeModel&) {
    return {};
}

std::string KsCHostICodePrinter::json(const KsCHostCodeModel&) {
    return "{\"files\": []}";
}
