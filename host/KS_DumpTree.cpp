// The stand-in dump library: a master page and one HTML page per linked object, written
// breadth-first from a queue so that deep trees need no deep native stack.
#include "ItfHostInterface/KS_Dump.h"

#include <cstdio>
#include <cstdlib>
#include <cxxabi.h>
#include <deque>
#include <filesystem>
#include <fstream>
#include <string>
#include <unordered_map>

namespace {

ZnCXString outputDirectory;

std::string escaped(std::string_view text) {
    std::string out;
    out.reserve(text.size());
    for (char c : text) {
        switch (c) {
        case '<':
            out += "&lt;";
            break;
        case '>':
            out += "&gt;";
            break;
        case '&':
            out += "&amp;";
            break;
        case '"':
            out += "&quot;";
            break;
        default:
            out += c;
        }
    }
    return out;
}

// The object's class as the program names it, for page names and link texts.
std::string classNameOf(KS_Dumpable* object) {
    int status = 0;
    const char* mangled = typeid(*object).name();
    char* name = abi::__cxa_demangle(mangled, nullptr, nullptr, &status);
    std::string text = status == 0 && name ? name : mangled;
    std::free(name);
    return text;
}

class PaletteColorServer : public KS_HtmlColorServer {
public:
    ZnCXString colorOf(const char* className) override {
        static const char* const palette[] = {"#eef3fb", "#eefbf1", "#fbf6ee", "#f6eefb",
                                              "#fbeeee", "#eefbfb", "#f9fbee", "#f1f1f1"};
        unsigned hash = 0;
        for (const char* p = className ? className : ""; *p; ++p)
            hash = hash * 31u + static_cast<unsigned char>(*p);
        return palette[hash % (sizeof palette / sizeof *palette)];
    }
};

} // namespace

KS_Dumpable::~KS_Dumpable() = default;
ZnCXString KS_Dumpable::getDumpFileName() {
    return "";
}
ZnCXString KS_Dumpable::getNameForDump() {
    return "";
}
ZnCXString KS_Dumpable::getLinkNameForDump() {
    return "";
}
ZnCXString KS_Dumpable::getColorForDump() {
    return "";
}
void KS_Dumpable::dumpStart(KS_Dump* dump, const char* className) {
    dump->beginSection(className);
}
void KS_Dumpable::dumpFinish(KS_Dump* dump) {
    dump->endSection();
}
void KS_Dumpable::dump(KS_Dump* dump) {
    dumpContents(dump, false);
}
KS_Dump* KS_Dumpable::dumpContents(KS_Dump*, bool) {
    return nullptr;
}

KS_HtmlColorServer::~KS_HtmlColorServer() = default;
KS_Dump::~KS_Dump() = default;

void KS_DumpHtml::setOutputDirectory(const ZnCXString& directory) {
    outputDirectory = directory;
}
ZnCXString KS_DumpHtml::getOutputDirectory() {
    return outputDirectory;
}

KS_HtmlColorServer* GLB_GetHtmlColorServer() {
    static PaletteColorServer server;
    return &server;
}

struct KS_DumpTree::Impl {
    KS_HtmlColorServer* colors = nullptr;
    std::string masterFile;
    std::string title;
    std::string page;     // text of the page being written
    std::string pageName; // its file name
    int depth = 0;        // open sections on it
    std::unordered_map<KS_Dumpable*, std::string> pages;
    std::deque<KS_Dumpable*> pending;
    int nextPage = 0;

    std::string pageOf(KS_Dumpable* object) {
        auto found = pages.find(object);
        if (found != pages.end())
            return found->second;
        std::string name = object->getDumpFileName().str();
        if (name.empty())
            name = classNameOf(object) + "_" + std::to_string(++nextPage) + ".html";
        pages.emplace(object, name);
        pending.push_back(object);
        return name;
    }

    void open(const std::string& name, const std::string& heading) {
        pageName = name;
        page = "<!DOCTYPE html>\n<html><head><meta charset=\"utf-8\"><title>" + escaped(heading) +
               "</title>\n<style>body{font-family:sans-serif}"
               "div.section{border:1px solid #999;margin:6px 0;padding:4px 8px}"
               "div.class{font-weight:bold;margin-bottom:4px}"
               "span.key{display:inline-block;min-width:16em;color:#555}</style>"
               "</head><body>\n";
        if (name != masterFile)
            page += "<p><a href=\"" + escaped(masterFile) + "\">" + escaped(title) + "</a></p>\n";
    }

    void close() {
        while (depth > 0)
            endSection();
        page += "</body></html>\n";
        std::filesystem::path path = outputDirectory.str();
        path /= pageName;
        std::ofstream(path, std::ios::binary) << page;
        page.clear();
    }

    void endSection() {
        page += "</div>\n";
        --depth;
    }

    void row(const ZnCXString& name, const std::string& valueHtml) {
        if (depth == 0) {
            page += "<div class=\"section\">\n";
            ++depth;
        }
        page += "<div><span class=\"key\">" + escaped(name.view()) + "</span> <span>" + valueHtml +
                "</span></div>\n";
    }

    void link(const ZnCXString& name, KS_Dumpable* object) {
        if (!object) {
            row(name, "null");
            return;
        }
        std::string target = pageOf(object);
        std::string text = object->getLinkNameForDump().str();
        if (text.empty())
            text = classNameOf(object);
        row(name, "<a href=\"" + escaped(target) + "\">" + escaped(text) + "</a>");
    }
};

KS_DumpTree::KS_DumpTree(KS_HtmlColorServer* colors) : impl_(new Impl()) {
    impl_->colors = colors;
}

KS_DumpTree::~KS_DumpTree() {
    closeAllFiles();
    delete impl_;
}

void KS_DumpTree::setMasterFile(const ZnCXString& fileName, const ZnCXString& title) {
    impl_->masterFile = fileName.str();
    impl_->title = title.str();
    impl_->open(impl_->masterFile, impl_->title);
    impl_->page += "<h1>" + escaped(title.view()) + "</h1>\n";
}

void KS_DumpTree::writeHeadline(int level, const ZnCXString& text, const ZnCXString& extra) {
    int h = level < 1 ? 1 : level > 6 ? 6 : level;
    impl_->page += "<h" + std::to_string(h) + ">" + escaped(text.view());
    if (!extra.isEmpty())
        impl_->page += " <small>" + escaped(extra.view()) + "</small>";
    impl_->page += "</h" + std::to_string(h) + ">\n";
}

void KS_DumpTree::addProperty(const ZnCXString& name, KS_Dumpable* object, bool link) {
    if (link || !object)
        impl_->link(name, object);
    else
        impl_->row(name, escaped(object->getNameForDump().view()));
}

void KS_DumpTree::addProperty(const ZnCXString& name, const ZnCXString& text, bool) {
    impl_->row(name, escaped(text.view()));
}

void KS_DumpTree::addProperty(const ZnCXString& name, int value) {
    impl_->row(name, std::to_string(value));
}

void KS_DumpTree::addProperty(const ZnCXString& name, KS_Dumpable* object, ConnectType) {
    impl_->link(name, object);
}

void KS_DumpTree::beginSection(const char* className) {
    std::string color = impl_->colors ? impl_->colors->colorOf(className).str() : "#ffffff";
    impl_->page += "<div class=\"section\" style=\"background:" + escaped(color) +
                   "\"><div class=\"class\">" + escaped(className ? className : "") + "</div>\n";
    ++impl_->depth;
}

void KS_DumpTree::endSection() {
    if (impl_->depth > 0)
        impl_->endSection();
}

void KS_DumpTree::closeAllFiles() {
    if (impl_->pageName.empty())
        return;
    impl_->close();
    while (!impl_->pending.empty()) {
        KS_Dumpable* object = impl_->pending.front();
        impl_->pending.pop_front();
        impl_->open(impl_->pages[object], impl_->title);
        object->dump(this);
        impl_->close();
    }
    impl_->pageName.clear();
}
