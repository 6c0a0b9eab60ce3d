#pragma once

#include "platform/Value.h"

#include <memory>
#include <string>
#include <string_view>
#include <unordered_map>
#include <vector>

namespace pelorus {

class PelorusModelNode;
using PelorusModelNodes = std::vector<std::shared_ptr<const PelorusModelNode>>;
/// Path ("/", "/GSM", "/GSM/Cell") to node.
using PathDictionary = std::unordered_map<std::string, std::shared_ptr<const PelorusModelNode>>;

/// Makes a node's path its child's: "/" and "GSM" give "/GSM", that and "Cell" give "/GSM/Cell". A name that
/// holds a slash keeps it.
void appendPathComponent(std::string& path, std::string_view name);

/// One node of the display tree; it never changes. A leaf has a value and no children, an inner node has
/// children (perhaps none) and no value.
class PelorusModelNode {
public:
    virtual ~PelorusModelNode() = default;

    const std::string& displayName() const { return name; }
    virtual const PelorusModelNodes* childNodes() const { return nullptr; }
    virtual const std::string* value() const { return nullptr; }

    /// The tree of a display object, its root named "Pelorus" at the path "/"; every node is entered in
    /// `paths`. Of siblings with the same name all are children, and the last one is found by path.
    static std::shared_ptr<const PelorusModelNode> makeTreeFromObject(const Value& object,
                                                                      PathDictionary& paths);
    /// The same for who asks for no node by its path.
    static std::shared_ptr<const PelorusModelNode> makeTreeFromObject(const Value& object);

protected:
    explicit PelorusModelNode(std::string_view nodeName) : name(nodeName) {}

private:
    std::string name;
};

class PelorusModelLeafNode : public PelorusModelNode {
public:
    PelorusModelLeafNode(std::string_view nodeName, std::string_view text)
        : PelorusModelNode(nodeName), string(text)
    {}
    const std::string* value() const override { return &string; }

private:
    std::string string;
};

class PelorusModelTreeNode : public PelorusModelNode {
public:
    PelorusModelTreeNode(std::string_view nodeName, PelorusModelNodes nodes)
        : PelorusModelNode(nodeName), children(std::move(nodes))
    {}
    const PelorusModelNodes* childNodes() const override { return &children; }

private:
    PelorusModelNodes children;
};

} // namespace pelorus
