#include "ItfIterationContext/KsCItfIterationContextServer.h"

#include "ItfHostInterface/KS_Dump.h"
#include "ItfHostInterface/KS_IterContext.h"
#include "ItfIterationContext/KsCItfIterationContext.h"
#include "ItfMessages/KsCItfMessages.h"

KS_Dump* KsCItfIterationContext::dumpContents(KS_Dump* dump, bool) {
    dumpStart(dump, "KsCItfIterationContext");
    dump->writeHeadline(1, "KsCItfIterationContext", "");
    dump->addProperty("Name", name_, false);
    dump->addProperty("StartIndex", startIndex_);
    dump->addProperty("EndIndex", endIndex_);
    dump->addProperty("CvIterationContext",
                      hostContext_ ? hostContext_->toString() : ZnCXString("---"), false);
    dumpFinish(dump);
    return nullptr;
}

namespace {

// The server's own page: a link to each context.
class ContextListPage : public KS_Dumpable {
public:
    explicit ContextListPage(const KsCItfIterationContextServer& server) : server_(server) {}
    KS_Dump* dumpContents(KS_Dump* dump, bool) override {
        dumpStart(dump, "KsCItfIterationContextServer");
        dump->writeHeadline(1, "KsCItfIterationContextServer", "");
        for (KsCItfIterationContext* context : server_.contexts())
            dump->addProperty("IterationContext", context, true);
        dumpFinish(dump);
        return nullptr;
    }

private:
    const KsCItfIterationContextServer& server_;
};

} // namespace

KsCItfIterationContextServer::~KsCItfIterationContextServer() {
    exit();
}

bool KsCItfIterationContextServer::init(KsCItfMessages* messages, KsCCvIterConFactory* factory,
                                        KsCItfVariableServer* variableServer) {
    messages_ = messages;
    factory_ = factory;
    variableServer_ = variableServer;
    return true;
}

bool KsCItfIterationContextServer::exit() {
    for (KsCItfIterationContext* context : contexts_)
        delete context;
    decltype(contexts_)().swap(contexts_);
    decltype(byName_)().swap(byName_);
    return true;
}

KsCItfIterationContext* KsCItfIterationContextServer::find(const ZnCXString& name) const {
    auto found = byName_.find(name.str());
    return found == byName_.end() ? nullptr : found->second;
}

bool KsCItfIterationContextServer::define(const ZnCXString& name, int startIndex, int endIndex,
                                          const KsCItfSrcRef* position) {
    if (find(name)) {
        messages_->reportTraversalError(position, "Redefinition of iteration context");
        return false;
    }
    // Reserve first, so that a failing allocation leaves neither table half changed.
    contexts_.reserve(contexts_.size() + 1);
    auto* context = new KsCItfIterationContext(name, startIndex, endIndex);
    try {
        byName_.emplace(name.str(), context);
    } catch (...) {
        delete context;
        throw;
    }
    contexts_.push_back(context);
    return true;
}

bool KsCItfIterationContextServer::lookup(const ZnCXString& name, const KsCItfSrcRef* position,
                                          KsCCvIterContext*& context) {
    KsCItfIterationContext* definition = find(name);
    if (!definition) {
        messages_->reportTraversalError(position, "Undefined iteration context: " + name);
        return false;
    }
    if (!definition->getHostContext()) {
        KsCCvIterContext* made =
            factory_ ? factory_->create(definition->getStartIndex(), definition->getEndIndex())
                     : nullptr;
        if (!made) {
            reportInternalError("KsCItfIterationContextServer", 10);
            return false;
        }
        definition->setHostContext(made);
    }
    context = definition->getHostContext();
    return true;
}

void KsCItfIterationContextServer::dump() {
    ContextListPage page(*this);
    KS_DumpTree writer(GLB_GetHtmlColorServer());
    writer.setMasterFile("KsCItfIterationContextServer.html", "Title");
    writer.addProperty("IterationContextServer", &page, KS_Dump::ConnectType(0));
    writer.closeAllFiles();
}
