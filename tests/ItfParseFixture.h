// Parses test-file text in memory with the real scanner, parser and node factory, the way a
// run does for one file.
#pragma once

#include "ItfFactory/KsCItfFactory.h"
#include "ItfMessages/KsCItfMessages.h"
#include "ItfParser/KsCItfParseSession.h"
#include "ItfSrcRef/KsCItfSrcRefServer.h"
#include "ItfTestSupport.h"
#include "ItfTypeNameRegistry/KsCItfTypeNameRegistry.h"
#include "KsCHostSrcRefServer.h"

#include <optional>
#include <string>
#include <vector>

class ItfParseTest : public ItfHostTest {
protected:
    ItfParseTest() {
        srcRefServer.init(&hostSrcRefs);
        messages_.init(&srcRefServer, &factory);
        registry.init(nullptr, &messages_);
        for (const char* name : {"sint8", "uint8", "sint16", "uint16", "sint32", "uint32",
                                 "float32", "boolean", "UNDEFINED_TYPE"})
            registry.addTypeName(name);
        session.emplace(&factory, &messages_, &registry);
    }
    ~ItfParseTest() override {
        session.reset();
        factory.exit();
        srcRefServer.exit();
    }

    // Parses `text` as the file `base`; the root when the parse was accepted, else null.
    KsCItfTranslationUnit* parse(const std::string& text, const char* base = "t",
                                 int depth = KsCItfParseSession::kParserDepth) {
        return session->parseFile(base, text.c_str(), depth);
    }

    // The nodes of class T built so far, in creation order.
    template <class T> std::vector<T*> nodes() const {
        std::vector<T*> found;
        for (KS_Dumpable* object : factory.dumpables())
            if (auto* node = dynamic_cast<T*>(object))
                found.push_back(node);
        return found;
    }
    template <class T> T* first() const {
        auto all = nodes<T>();
        return all.empty() ? nullptr : all.front();
    }

    KsCHostSrcRefServer hostSrcRefs;
    KsCItfSrcRefServer srcRefServer;
    KsCItfFactory factory;
    KsCItfMessages messages_;
    KsCItfTypeNameRegistry registry;
    std::optional<KsCItfParseSession> session;
};
