#include "KsCHostIterContext.h"

#include <string>

KsCCvIterContext::~KsCCvIterContext() = default;
KsCCvIterConFactory::~KsCCvIterConFactory() = default;
KsCHostIterContext::~KsCHostIterContext() = default;
KsCHostIterContextFactory::~KsCHostIterContextFactory() = default;

ZnCXString KsCHostIterContext::toString() const {
    return ZnCXString("IterContext#" + std::to_string(number_) + "[" + std::to_string(start_) +
                      ":" + std::to_string(end_) + "]");
}

KsCCvIterContext* KsCHostIterContextFactory::create(int startIndex, int endIndex) {
    int number = static_cast<int>(contexts_.size()) + 1;
    contexts_.push_back(std::make_unique<KsCHostIterContext>(number, startIndex, endIndex));
    return contexts_.back().get();
}
