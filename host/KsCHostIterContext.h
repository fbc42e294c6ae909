// Host iteration contexts: a slice of indices, numbered in creation order.
#pragma once

#include "ItfHostInterface/KS_IterContext.h"

#include <memory>
#include <vector>

class KS_HOST_API KsCHostIterContext : public KsCCvIterContext {
public:
    KsCHostIterContext(int number, int start, int end)
        : number_(number), start_(start), end_(end) {}
    ~KsCHostIterContext() override;
    // "IterContext#<number>[<start>:<end>]"
    ZnCXString toString() const override;

    int number() const { return number_; }
    int start() const { return start_; }
    int end() const { return end_; }

private:
    int number_;
    int start_;
    int end_;
};

class KS_HOST_API KsCHostIterContextFactory : public KsCCvIterConFactory {
public:
    ~KsCHostIterContextFactory() override;
    KsCCvIterContext* create(int startIndex, int endIndex) override;
    const std::vector<std::unique_ptr<KsCHostIterContext>>& contexts() const { return contexts_; }

private:
    std::vector<std::unique_ptr<KsCHostIterContext>> contexts_;
};
