#include "KsCHostSrcRefServer.h"

KsCSrcRef::~KsCSrcRef() = default;
KsCSrcRefServer::~KsCSrcRefServer() = default;

KsCInternalSrcRef* KsCHostSrcRefServer::getSrcRef() {
    references_.push_back(std::make_unique<KsCHostSrcRef>());
    return references_.back().get();
}
