#pragma once
// The jsoncpp side of JSONTree, for the readers (which build trees from the
// values they read) and the tree's own writer.

#include <VelaMediaLib/document/format/JSONTree.h>

#include <json/value.h>

namespace VelaMediaLib {

struct JSONTreeAccess {
    static JSONTree make(const Json::Value& value) {
        JSONTree tree;
        if (!value.isNull()) tree.value_ = std::make_shared<const Json::Value>(value);
        return tree;
    }
    static const Json::Value& value(const JSONTree& tree) {
        static const Json::Value null;
        return tree.value_ ? *tree.value_ : null;
    }
};

/// A tree holding a copy of the value (a null value gives a null tree).
inline JSONTree jsonTreeFromValue(const Json::Value& value) { return JSONTreeAccess::make(value); }
/// The value the tree holds (null for a null tree).
inline const Json::Value& jsonTreeValue(const JSONTree& tree) { return JSONTreeAccess::value(tree); }

} // namespace VelaMediaLib
