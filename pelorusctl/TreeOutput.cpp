#include "pelorusctl/TreeOutput.h"

#include "platform/PrintableText.h"

#include <nlohmann/json.hpp>

namespace pelorus {

namespace {

using Json = nlohmann::ordered_json;

void addText(std::string& out, const PelorusModelNode& node, std::size_t depth)
{
    out.append(2 * depth, ' ');
    out += printable(node.displayName());
    if (node.value()) {
        out += ": ";
        out += printable(*node.value());
    }
    out += '\n';
    if (node.childNodes())
        for (const auto& child : *node.childNodes())
            addText(out, *child, depth + 1);
}

Json jsonOf(const PelorusModelNode& node, std::string& path)
{
    Json object = {{"name", node.displayName()}, {"path", path}};
    if (node.value()) {
        object["value"] = *node.value();
        return object;
    }
    Json children = Json::array();
    for (const auto& child : *node.childNodes()) {
        const std::size_t parentLength = path.size();
        appendPathComponent(path, child->displayName());
        children.push_back(jsonOf(*child, path));
        path.resize(parentLength);
    }
    object["children"] = std::move(children);
    return object;
}

} // namespace

std::string treeText(const PelorusModelNode& root)
{
    std::string text;
    addText(text, root, 0);
    return text;
}

std::string treeJson(const PelorusModelNode& root,
                     std::optional<std::chrono::sys_time<std::chrono::nanoseconds>> lastMessage)
{
    Json line = {{"time", nullptr}};
    if (lastMessage)
        line["time"] =
            static_cast<double>(static_cast<long double>(lastMessage->time_since_epoch().count()) / 1e9L);
    std::string path = "/";
    line["tree"] = jsonOf(root, path);
    return line.dump(-1, ' ', false, Json::error_handler_t::replace) + '\n';
}

} // namespace pelorus
