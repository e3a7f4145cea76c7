// FakeService / FakeConnector: configuration services held in memory for repository tests. Each
// fake counts its requests and can be made unreachable. Test support only; a connection's calls
// are thread-safe, setting a fake up is not.
#pragma once

#include <ace/OS_NS_strings.h>

#include <atomic>
#include <condition_variable>
#include <cstring>
#include <map>
#include <mutex>
#include <stdexcept>
#include <string>

#include "repository/ServiceConnection.h"

namespace Configuration {
namespace Testing {

struct FakeService {
    struct Item {
        std::string bytes;
        std::string time;
    };
    std::string name;                                           // the host name the service reports
    std::map<std::pair<std::string, std::string>, Item> items;  // (host, name)
    std::vector<ACE_CString> hosts;                             // answer of listHosts
    std::atomic<bool> down{false};
    std::mutex mutex;  // guards items and registrations
    std::atomic<int> retrieves{0}, timestamps{0}, stores{0}, changed{0}, refreshes{0}, restarts{0};
    std::vector<std::string> registrations;
    std::mutex gateMutex;  // guards stalled
    std::condition_variable gate;
    bool stalled = false;
    std::atomic<int> waiting{0};  // requests held by a stall so far

    // While stalled, timestamp requests wait as on a service that does not answer.
    void stall() {
        std::lock_guard<std::mutex> guard(gateMutex);
        stalled = true;
    }
    void release() {
        {
            std::lock_guard<std::mutex> guard(gateMutex);
            stalled = false;
        }
        gate.notify_all();
    }
    void passGate() {
        std::unique_lock<std::mutex> lock(gateMutex);
        if (stalled) {
            ++waiting;
            gate.wait(lock, [this] { return !stalled; });
        }
    }

    // This service; throws as an unreachable one would when down.
    FakeService& reached() {
        if (down) {
            throw std::runtime_error("service " + name + " unreachable");
        }
        return *this;
    }
    const Item& find(const ACE_CString& host, const ACE_CString& n) const {
        const auto it = items.find({host.c_str(), n.c_str()});
        if (it == items.end()) {
            throw std::runtime_error("No configuration found in response");
        }
        return it->second;
    }
    // Puts an item as the service would store it, with a time text.
    void put(const std::string& host, const std::string& n, const std::string& bytes,
             const std::string& time) {
        items[{host, n}] = Item{bytes, time};
    }
};

class FakeConnection : public ServiceConnection {
public:
    explicit FakeConnection(FakeService& s) : m_s(s.reached()), m_name(s.name.c_str()) {}
    const ACE_CString& hostName() const override { return m_name; }
    void retrieve(const ACE_CString& host, const ACE_CString& n, Quorvex::ByteArray& data,
                  std::size_t& length) override {
        std::lock_guard<std::mutex> guard(m_s.reached().mutex);
        ++m_s.retrieves;
        const std::string& b = m_s.find(host, n).bytes;
        length = b.size();
        data.reset(new unsigned char[b.size() + 1]);
        std::memcpy(data.get(), b.data(), b.size());
    }
    // A store without a time is stamped now, as the real service does.
    void store(const ACE_CString& host, const ACE_CString& n, const unsigned char* data,
               std::size_t length, const ACE_CString& time) override {
        std::lock_guard<std::mutex> guard(m_s.reached().mutex);
        ++m_s.stores;
        m_s.put(host.c_str(), n.c_str(), std::string(reinterpret_cast<const char*>(data), length),
                (time.length() > 0 ? time : BDateTime::Now().ToString()).c_str());
    }
    void getTimeStamp(const ACE_CString& host, const ACE_CString& n, BDateTime& ts) override {
        m_s.passGate();
        std::lock_guard<std::mutex> guard(m_s.reached().mutex);
        ++m_s.timestamps;
        ts = BDateTime(m_s.find(host, n).time.c_str());
    }
    void listHosts(std::vector<ACE_CString>& hosts) override { hosts = m_s.reached().hosts; }
    void listItems(const ACE_CString& host, std::vector<_HttpConfigurationItemInfo>& out) override {
        std::lock_guard<std::mutex> guard(m_s.reached().mutex);
        out.clear();
        for (const auto& [key, item] : m_s.items) {
            if (host == "*" || ACE_OS::strcasecmp(key.first.c_str(), host.c_str()) == 0) {
                out.push_back({key.first.c_str(), key.second.c_str(), item.time.c_str()});
            }
        }
    }
    void registerService(const ACE_CString& host, const ACE_CString& service,
                         const ACE_CString& connection) override {
        std::lock_guard<std::mutex> guard(m_s.reached().mutex);
        m_s.registrations.push_back(std::string(host.c_str()) + "|" + service.c_str() + "|" +
                                    connection.c_str());
    }
    void switchoverPersistent(const ACE_CString&) override { m_s.reached(); }
    void enableMergeNetworkCapture(bool, const ACE_CString&) override { m_s.reached(); }
    void signalChanged() override { ++m_s.reached().changed; }
    void signalRestart() override { ++m_s.reached().restarts; }
    void signalRefresh() override { ++m_s.reached().refreshes; }

private:
    FakeService& m_s;
    ACE_CString m_name;
};

// Connects by host name (ignoring case); the local host is the one named at construction.
class FakeConnector : public ServiceConnector {
public:
    explicit FakeConnector(std::string localHost) : m_local(std::move(localHost)) {}
    void add(const std::string& host, FakeService& service) { m_services[host] = &service; }
    std::unique_ptr<ServiceConnection> connectLocal() const override {
        return connect(m_local.c_str());
    }
    std::unique_ptr<ServiceConnection> connect(const ACE_CString& host) const override {
        const auto it = m_services.find(host.c_str());
        if (it == m_services.end()) {
            throw std::runtime_error(std::string("unknown host ") + host.c_str());
        }
        return std::make_unique<FakeConnection>(*it->second);
    }

private:
    struct IgnoringCase {
        bool operator()(const std::string& a, const std::string& b) const {
            return ACE_OS::strcasecmp(a.c_str(), b.c_str()) < 0;
        }
    };
    std::string m_local;
    std::map<std::string, FakeService*, IgnoringCase> m_services;
};

}  // namespace Testing
}  // namespace Configuration
