#include "ItfExprLocation/KsCItfExprLocationDB.h"

KsCItfExprLocationDB::~KsCItfExprLocationDB() {
    exit();
}

bool KsCItfExprLocationDB::init() {
    return true;
}

bool KsCItfExprLocationDB::exit() {
    for (auto& [key, entry] : entries_)
        delete entry;
    decltype(entries_)().swap(entries_);
    return true;
}

KsCItfExprLocDbEntry* KsCItfExprLocationDB::demandEntry(KS_ExprLocation* location) {
    auto found = entries_.find(location);
    if (found != entries_.end())
        return found->second;
    // The map's room first, so that an entry never exists without its place.
    auto slot = entries_.emplace(location, nullptr).first;
    try {
        slot->second = new KsCItfExprLocDbEntry(location);
    } catch (...) {
        entries_.erase(slot);
        throw;
    }
    return slot->second;
}
