// The stand-in host source references: each records its cause text; the server owns them all.
#pragma once

#include "ItfHostInterface/KsCSrcRefServer.h"

#include <memory>
#include <string>
#include <vector>

class KS_HOST_API KsCHostSrcRef : public KsCInternalSrcRef {
public:
    void setCause(const ZnCXString& cause) override { cause_ = cause.str(); }
    const std::string& cause() const { return cause_; }

private:
    std::string cause_;
};

class KS_HOST_API KsCHostSrcRefServer : public KsCSrcRefServer {
public:
    KsCInternalSrcRef* getSrcRef() override;
    const std::vector<std::unique_ptr<KsCHostSrcRef>>& references() const { return references_; }

private:
    std::vector<std::unique_ptr<KsCHostSrcRef>> references_;
};
