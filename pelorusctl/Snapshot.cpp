#include "pelorusctl/Commands.h"
#include "pelorusctl/Output.h"
#include "pelorusctl/TreeOutput.h"
#include "platform/PrintableText.h"
#include "platform/PropertyList.h"
#include "platform/linux/Files.h"

#include <algorithm>
#include <cerrno>
#include <cstring>
#include <fmt/format.h>
#include <nlohmann/json.hpp>
#include <vector>

namespace pelorus {

namespace {

using Json = nlohmann::ordered_json;

std::string textAt(const Dictionary& dictionary, std::string_view key)
{
    const Value value = dictionary.at(key);
    return value.string() ? *value.string() : std::string();
}

/// How many texts the containers of a display hold.
std::size_t countRows(const Value& value)
{
    std::size_t rows = 0;
    if (const Array* array = value.array())
        for (const Value& element : array->elements)
            rows += countRows(element);
    else if (const Dictionary* dictionary = value.dictionary())
        for (const auto& entry : *dictionary)
            rows += countRows(entry.value);
    else
        rows = 1;
    return rows;
}

/// What one entry of "Data" carries, and how large it is.
struct Entry {
    std::string description;
    std::optional<std::size_t> rawBytes; // "DisplayState" as raw messages
    std::optional<std::size_t> rows;     // of "Display"
    std::optional<std::size_t> dlfBytes;
};

Entry entryOf(const Value& value)
{
    Entry entry;
    const Dictionary* carried = value.dictionary();
    if (!carried)
        return entry;
    entry.description = textAt(*carried, "Description");
    if (const Value raw = carried->at("DisplayState"); raw.data())
        entry.rawBytes = raw.data()->size();
    if (const Value display = carried->at("Display"))
        entry.rows = countRows(display);
    if (const Value dlf = carried->at("DLF"); dlf.data())
        entry.dlfBytes = dlf.data()->size();
    return entry;
}

std::string lineOf(const Entry& entry)
{
    std::string sizes;
    const auto add = [&sizes](const std::optional<std::size_t>& size, std::string_view what) {
        if (size)
            sizes += fmt::format("{}{} {}", sizes.empty() ? ": " : ", ", *size, what);
    };
    add(entry.rows, "rows");
    add(entry.rawBytes, "bytes of raw messages");
    add(entry.dlfBytes, "bytes of DLF");
    return printable(entry.description.empty() ? "(no description)" : entry.description) + sizes + '\n';
}

Json jsonOf(const Entry& entry)
{
    Json object = {{"description", entry.description}};
    const auto add = [&object](const std::optional<std::size_t>& size, const char* name) {
        if (size)
            object[name] = *size;
    };
    add(entry.rows, "rows");
    add(entry.rawBytes, "rawBytes");
    add(entry.dlfBytes, "dlfBytes");
    return object;
}

Data dlfOf(const std::vector<Value>& entries)
{
    for (const Value& entry : entries)
        if (entry.dictionary())
            if (Data dlf = entry.dictionary()->at("DLF").sharedData())
                return dlf;
    return nullptr;
}

int extract(const Data& dlf, const SnapshotOptions& options)
{
    if (!dlf)
        return fail(options.snapshot, "carries no DLF file");
    return replaceWholeFile(options.extractDlf, std::as_bytes(std::span(*dlf)))
               ? kSuccess
               : fail(options.extractDlf, std::strerror(errno));
}

} // namespace

int snapshot(const SnapshotOptions& options)
{
    if (isDirectory(options.snapshot))
        return fail(options.snapshot, std::strerror(EISDIR));
    errno = 0;
    const auto bytes = readWholeFile(options.snapshot);
    if (!bytes)
        return fail(options.snapshot, std::strerror(errno ? errno : EFBIG));
    if (bytes->empty())
        return fail(options.snapshot, "the file is empty");
    std::string why;
    const Value content = parsePropertyList(*bytes, &why);
    if (!content)
        return fail(options.snapshot, why);
    if (!content.dictionary() || !content.dictionary()->find("Timestamp"))
        return fail(options.snapshot, "a property list, but no snapshot");

    const Dictionary& fields = *content.dictionary();
    const Value data = fields.at("Data");
    const std::vector<Value> values = data.array() ? data.array()->elements : std::vector<Value>();
    if (options.json) {
        Json entries = Json::array();
        for (const Value& value : values)
            entries.push_back(jsonOf(entryOf(value)));
        const Json object = {{"timestamp", textAt(fields, "Timestamp")},
                             {"description", textAt(fields, "Description")},
                             {"entries", entries}};
        print(object.dump(-1, ' ', false, Json::error_handler_t::replace) + '\n');
    } else {
        std::string text =
            fmt::format("Timestamp: {}\nDescription: {}\n", printable(textAt(fields, "Timestamp")),
                        printable(textAt(fields, "Description")));
        for (const Value& value : values)
            text += lineOf(entryOf(value));
        print(text);
    }
    return finishOutput(options.extractDlf.empty() ? kSuccess : extract(dlfOf(values), options));
}

} // namespace pelorus
