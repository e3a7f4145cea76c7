// Store, retrieve, existence, times and listings of configuration documents.
#include "ItemOperations.h"

#include "Answer.h"
#include "Quorvex/Base64Coder.h"
#include "StoredDocuments.h"
#include "TimeText.h"

namespace ConfigurationService {
namespace {

using Configuration::DirectoryStore;
using Configuration::StoredItem;

std::string decodeBase64(const std::string& text) {
    std::string compact;
    const std::string* source = &text;
    if (text.find_first_of(" \t\r\n") != std::string::npos) {
        for (char c : text) {
            if (c != ' ' && c != '\t' && c != '\r' && c != '\n') {
                compact += c;
            }
        }
        source = &compact;
    }
    try {
        std::size_t length = 0;
        const Quorvex::ByteArray bytes =
            Base64Coder::Decode(source->data(), source->size(), length);
        return std::string(reinterpret_cast<const char*>(bytes.get()), length);
    } catch (const std::exception& e) {
        throw OperationFailed(std::string("Configuration is not valid Base64: ") + e.what());
    }
}

// The time a "Store" asks for, or kNow.
std::int64_t requestedTime(const Request& request) {
    const std::string text = request.optional("LastModifiedTime");
    if (text.empty()) {
        return DirectoryStore::kNow;
    }
    try {
        return TimeText::parse(text);
    } catch (const std::invalid_argument& e) {
        throw OperationFailed(e.what());
    }
}

StoredItem findItem(const DirectoryStore& store, const Request& request) {
    const std::string& host = request.required("Host");
    const std::string& name = request.required("ConfigurationName");
    StoredItem item;
    if (!store.retrieve(host.c_str(), name.c_str(), item)) {
        throw OperationFailed::notFound(host, name);
    }
    return item;
}

// Tags written per item of a listing, built once.
const std::string kItemTag = "ConfigurationItem";
const std::string kHostTag = "HostName";
const std::string kNameTag = "ConfigurationName";
const std::string kTimeTag = "LastModifiedTime";
const std::string kConfigurationTag = "Configuration";

std::size_t listedSize(const StoredItem& item) {
    return 2 * kItemTag.size() + 5 +
           Answer::elementSize(kHostTag, item.host.c_str(), item.host.length()) +
           Answer::elementSize(kNameTag, item.name.c_str(), item.name.length()) +
           Answer::plainElementSize(kTimeTag, TimeText::kLength);
}

void appendListed(Answer& answer, const StoredItem& item) {
    char time[TimeText::kLength];
    answer.open(kItemTag);
    answer.element(kHostTag, item.host.c_str(), item.host.length());
    answer.element(kNameTag, item.name.c_str(), item.name.length());
    answer.element(kTimeTag, time, TimeText::format(item.lastModifiedMs, time));
    answer.close(kItemTag);
}

Reply storedReply(const std::string& operation, std::int64_t time) {
    return Reply{
        200,
        Answer::success(operation).element("LastModifiedTime", TimeText::format(time)).finish()};
}

}  // namespace

void ItemOperations::registerInto(Operations& table) {
    table.add("Store", [this](const Request& r) { return store(r); });
    table.add("StoreMaster", [this](const Request& r) { return storeMaster(r); });
    table.add("Retrieve", [this](const Request& r) { return retrieve(r); });
    table.add(
        "RetrieveItems", [this](const Request& r) { return retrieveItems(r); }, true, false);
    table.add("Exists", [this](const Request& r) { return exists(r); });
    table.add("GetLastModifiedTime", [this](const Request& r) { return lastModifiedTime(r); });
    table.add("ListItems", [this](const Request& r) { return listItems(r); });
}

std::int64_t ItemOperations::storeHere(const Request& request, const std::string& bytes,
                                       std::int64_t time) {
    const std::string& host = request.required("Host");
    const std::string& name = request.required("ConfigurationName");
    try {
        return m_context.store.store(ACE_CString(host.data(), host.size()),
                                     ACE_CString(name.data(), name.size()), bytes.data(),
                                     bytes.size(), time);
    } catch (const std::invalid_argument& e) {
        throw OperationFailed(e.what());
    }
}

Reply ItemOperations::store(const Request& request) {
    const std::string bytes = decodeBase64(request.required("Configuration"));
    return storedReply("Store", storeHere(request, bytes, requestedTime(request)));
}

Reply ItemOperations::storeMaster(const Request& request) {
    const std::string bytes = decodeBase64(request.required("Configuration"));
    std::int64_t time = requestedTime(request);
    if (!m_context.master.isMaster()) {
        // The master gets the document first, so this copy never holds what the master lacks;
        // both keep the same time.
        if (time == DirectoryStore::kNow) {
            time = TimeText::now();
        }
        try {
            m_context.master.store(request.required("Host"), request.required("ConfigurationName"),
                                   bytes, time);
        } catch (const std::exception& e) {
            throw OperationFailed(std::string("the master refused the document: ") + e.what(), 502);
        }
    }
    return storedReply("StoreMaster", storeHere(request, bytes, time));
}

Reply ItemOperations::retrieve(const Request& request) {
    const StoredItem item = findItem(m_context.store, request);
    const std::string& bytes = *item.bytes;
    char time[TimeText::kLength];
    const std::size_t timeLength = TimeText::format(item.lastModifiedMs, time);
    Answer answer = Answer::success("Retrieve");
    if (bytes.size() >= kCachedBase64From) {
        // The document's Base64 text, encoded once, goes to the socket from its shared copy.
        answer.element(kTimeTag, time, timeLength);
        Reply reply;
        reply.body = answer.finishAround(kConfigurationTag, reply.tail);
        reply.shared = m_base64.text(item.bytes);
        return reply;
    }
    // Small documents: one buffer of the answer's final size, encoded straight into it.
    answer.reserve(Answer::plainElementSize(kTimeTag, timeLength) +
                   Answer::base64ElementSize(kConfigurationTag, bytes.size()));
    answer.element(kTimeTag, time, timeLength);
    answer.base64(kConfigurationTag, bytes.data(), bytes.size());
    return Reply{200, answer.finish()};
}

Reply ItemOperations::retrieveItems(const Request& request) {
    const std::string& host = request.required("Host");
    const std::string& names = request.required("ConfigurationName");
    return Reply{200, StoredDocuments::collect(m_context.store, host, names, kNameSeparators)};
}

Reply ItemOperations::exists(const Request& request) {
    const bool found = m_context.store.exists(request.required("Host").c_str(),
                                              request.required("ConfigurationName").c_str());
    return Reply{
        200, Answer::success("Exists").element("ConfigurationExists", found ? "1" : "0").finish()};
}

Reply ItemOperations::lastModifiedTime(const Request& request) {
    const StoredItem item = findItem(m_context.store, request);
    return Reply{200, Answer::success("GetLastModifiedTime")
                          .element("LastModifiedTime", TimeText::format(item.lastModifiedMs))
                          .finish()};
}

Reply ItemOperations::listItems(const Request& request) {
    const ACE_CString host(request.required("Host").c_str());
    Answer answer = Answer::success("ListItems");
    // Read in place: sized in a first pass over the items, written in a second.
    m_context.store.read(host, [&answer](const std::vector<const StoredItem*>& items) {
        std::size_t size = 0;
        for (const StoredItem* item : items) {
            size += listedSize(*item);
        }
        answer.reserve(size);
        for (const StoredItem* item : items) {
            appendListed(answer, *item);
        }
    });
    return Reply{200, answer.finish()};
}

}  // namespace ConfigurationService
