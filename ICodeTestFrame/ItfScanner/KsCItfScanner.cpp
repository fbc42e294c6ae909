// The parts of the scanner around the generated automaton (KsCItfScanner.re).
#include "ItfScanner/KsCItfScanner.h"

#include "ItfFactory/KsCItfFactory.h"
#include "ItfMessages/KsCItfMessages.h"
#include "ItfSrcRef/KsCItfParseInfo.h"

#include <string_view>

KsUItfTokenValue theTokenValue{};
int theColumn = 0;

// Every file is counted from column 0, whatever the previous file left behind.
KsCItfScanner::KsCItfScanner() {
    theColumn = 0;
}

void KsCItfScanner::setInput(const char* text) {
    cursor_ = text;
    token_ = nullptr;
    tokenLength_ = 0;
    pooledToken_ = nullptr;
}

void KsCItfScanner::error(const char* text) {
    if (!theParseInfo)
        return;
    if (KsCItfMessages* messages = theParseInfo->getMessages())
        messages->reportSyntaxError(theParseInfo->getFileName(), line_, theColumn,
                                    text ? text : "");
    theParseInfo->setSuccess(false);
}

const char* KsCItfScanner::getTokenText() {
    if (pooledToken_)
        return pooledToken_;
    if (!token_ || tokenLength_ == 0)
        return pooledToken_ = "";
    KsCItfFactory* factory = theParseInfo ? theParseInfo->getFactory() : nullptr;
    // Without a factory there is no pool to keep the text alive in.
    if (!factory)
        return "";
    return pooledToken_ = factory->intern(std::string_view(token_, tokenLength_));
}
