// Remembers, for every location the operation factory made, whether its data type and its
// scaling were defaulted, so that an assignment can give its own to an unannotated right side.
#pragma once

#include "ItfBase/KsCItfMemory.h"

#include <unordered_map>

class KS_ExprLocation;

class KsCItfExprLocDbEntry : public KsCItfObject {
public:
    explicit KsCItfExprLocDbEntry(KS_ExprLocation* key) : key_(key) {}
    virtual ~KsCItfExprLocDbEntry() = default;
    KS_ExprLocation* getKey() const { return key_; }
    bool isTypeDefaulted() const { return typeDefaulted_; }
    bool isScalingDefaulted() const { return scalingDefaulted_; }
    void setTypeDefaulted(bool defaulted) { typeDefaulted_ = defaulted; }
    void setScalingDefaulted(bool defaulted) { scalingDefaulted_ = defaulted; }

private:
    KS_ExprLocation* key_ = nullptr;
    bool typeDefaulted_ = false;
    bool scalingDefaulted_ = false;
};

class KsCItfExprLocationDB : public KsCItfObject {
public:
    virtual ~KsCItfExprLocationDB();
    virtual bool init();
    // Destroys every entry.
    virtual bool exit();
    // The entry of `location`, made with both flags false on first demand. Never null.
    KsCItfExprLocDbEntry* demandEntry(KS_ExprLocation* location);
    std::size_t size() const { return entries_.size(); }

private:
    // Keyed by the location: an assignment consults it, so a walk would make runs quadratic.
    std::unordered_map<KS_ExprLocation*, KsCItfExprLocDbEntry*, std::hash<KS_ExprLocation*>,
                       std::equal_to<KS_ExprLocation*>,
                       KsCItfAllocator<std::pair<KS_ExprLocation* const, KsCItfExprLocDbEntry*>>>
        entries_;
};
