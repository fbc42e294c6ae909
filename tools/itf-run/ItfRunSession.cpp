#include "ItfRunSession.h"

#include "ItfControl/KsCItfControlIF.h"
#include "KsCHostCodeModel.h"
#include "KsCHostICodePrinter.h"
#include "KsCHostMemController.h"
#include "KsCHostOptions.h"

#include <system_error>

namespace {

// The module only sees the current directory; every run leaves it as it found it.
class DirectoryScope {
public:
    bool enter(const std::filesystem::path& directory, std::string& error) {
        std::error_code ec;
        previous_ = std::filesystem::current_path(ec);
        if (!ec)
            std::filesystem::current_path(directory, ec);
        if (ec) {
            error = "cannot enter " + directory.string() + ": " + ec.message();
            return false;
        }
        entered_ = true;
        return true;
    }
    ~DirectoryScope() {
        std::error_code ec;
        if (entered_)
            std::filesystem::current_path(previous_, ec);
    }

private:
    std::filesystem::path previous_;
    bool entered_ = false;
};

// The memory controller is process-wide for the module; it must outlive every block.
class MemoryScope {
public:
    explicit MemoryScope(KsCHostMemController& memory) { pKSMemory = &memory; }
    ~MemoryScope() { pKSMemory = nullptr; }
    MemoryScope(const MemoryScope&) = delete;
    MemoryScope& operator=(const MemoryScope&) = delete;
};

} // namespace

bool runItf(const std::filesystem::path& directory, const KsCHostConfig& config,
            const ItfRunSettings& settings, ItfSuiteRun& result, std::string& error) {
    result = ItfSuiteRun{};
    DirectoryScope where;
    if (!where.enter(directory, error))
        return false;

    KsCHostOptions options;
    options.enableICodeTest = !settings.disable;
    options.defaultOperationLevel = settings.defaultLevel;
    options.dumpTree = settings.dumpTree;
    KsCHostMessageServer& server = KsCHostMessageServer::instance();
    server.clear();
    KsCHostMessageServer::setShowInternalInfo(settings.showInternalInfo);
    // Bytes the scanner passes through carry no meaning and must not mix with the output.
    KsCHostMessageServer::setScannerOutput(nullptr);

    KsCHostMemController memory;
    {
        MemoryScope installed(memory);
        KsCHostCodeModel model(config);
        auto* factory = new KsCIvToCvTestFactory(&options);
        KsCItfControlIF* control = factory->getICodeTest();
        result.outcome.init = control->init(model.container(), model.exprDescrComponent(),
                                            model.codeViewData(), model.tupelServer(), &options);
        result.outcome.run = result.outcome.init && control->run();
        result.outcome.exit = control->exit();
        delete factory;

        result.messages = server.messages();
        if (settings.wantListing)
            result.listing = KsCHostICodePrinter::listing(model);
        if (settings.wantJson)
            result.icodeJson = KsCHostICodePrinter::json(model);
    }
    server.clear();
    result.leakedBlocks = memory.liveBlocks();
    result.leakedBytes = memory.liveBytes();
    return true;
}
