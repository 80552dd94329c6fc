// SPDX-License-Identifier: Apache-2.0
#include "core/MpvLoad.h"

namespace orvtarn {
namespace {

// A map of values as mpv takes them. What is put in must outlive it.
class NodeMap {
public:
    void put(const char* key, const char* text) {
        mpv_node node = {};
        node.format = MPV_FORMAT_STRING;
        node.u.string = const_cast<char*>(text);  // only read by mpv
        put(key, node);
    }
    void put(const char* key, const mpv_node& node) {
        mKeys.push_back(const_cast<char*>(key));
        mValues.push_back(node);
    }

    mpv_node node() {
        mList = {static_cast<int>(mValues.size()), mValues.data(), mKeys.data()};
        mpv_node node = {};
        node.format = MPV_FORMAT_NODE_MAP;
        node.u.list = &mList;
        return node;
    }

private:
    std::vector<char*> mKeys;
    std::vector<mpv_node> mValues;
    mpv_node_list mList = {};
};

}  // namespace

// By the arguments' names: mpv 0.38 put another one before the options.
int loadMedia(mpv_handle* mpv, const std::string& name, const MpvOptions& options) {
    NodeMap forMedia;
    for (const auto& [option, value] : options) forMedia.put(option.c_str(), value.c_str());
    NodeMap command;
    command.put("name", "loadfile");
    command.put("url", name.c_str());
    command.put("options", forMedia.node());
    mpv_node node = command.node();
    // mpv keeps its answer, the entry of its playlist, for good unless somebody takes it.
    mpv_node answer = {};
    const int error = mpv_command_node(mpv, &node, &answer);
    mpv_free_node_contents(&answer);
    return error;
}

}  // namespace orvtarn
