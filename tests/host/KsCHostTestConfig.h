// Host configurations for the host's tests: the embedded default with some sections added.
#pragma once

#include "KsCHostConfig.h"

#include <gtest/gtest.h>
#include <nlohmann/json.hpp>

#include <string>

// The embedded default with the patch's top-level sections: "dataDictionary" objects are
// appended to the default's, every other section replaces the default's.
inline std::string withDefault(const std::string& patch) {
    nlohmann::ordered_json document =
        nlohmann::ordered_json::parse(KsCHostConfig::embeddedDefaultText());
    nlohmann::ordered_json extra = nlohmann::ordered_json::parse(patch);
    for (auto& [key, value] : extra.items()) {
        if (key == "dataDictionary")
            for (auto& object : value)
                document[key].push_back(object);
        else
            document[key] = value;
    }
    return document.dump();
}

inline KsCHostConfig parsedConfig(const std::string& json) {
    KsCHostConfig config;
    std::string error;
    EXPECT_TRUE(KsCHostConfig::parse(json, config, error)) << error;
    return config;
}

inline KsCHostConfig defaultConfigWith(const std::string& patch) {
    return parsedConfig(withDefault(patch));
}
