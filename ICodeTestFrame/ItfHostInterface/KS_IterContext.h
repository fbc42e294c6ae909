// Host iteration contexts: a slice of indices that loops and vector accesses iterate over.
#pragma once

#include "KsHostApi.h"
#include "ZnCXString.h"

class KS_HOST_API KsCCvIterContext {
public:
    virtual ~KsCCvIterContext();
    virtual ZnCXString toString() const = 0;
};

class KS_HOST_API KsCCvIterConFactory {
public:
    virtual ~KsCCvIterConFactory();
    virtual KsCCvIterContext* create(int startIndex, int endIndex) = 0;
};
