// ItemOperations: the operations on stored documents: "Store", "StoreMaster", "Retrieve",
// "RetrieveItems", "Exists", "GetLastModifiedTime" and "ListItems". Documents travel as Base64
// text; "RetrieveItems" answers the element-tree XML of the requested documents. Holds a
// reference to the context and the Base64 texts of large documents; thread-safe.
#pragma once

#include <cstdint>
#include <string>

#include "Base64Cache.h"
#include "Operations.h"
#include "ServiceContext.h"

namespace ConfigurationService {

class ItemOperations {
public:
    // Separators of the names in a "RetrieveItems" request (either one).
    static constexpr const char* kNameSeparators = ";,";

    explicit ItemOperations(ServiceContext& context)
        : m_context(context), m_base64(kCachedBase64Budget) {}
    // Adds the operations to the table.
    void registerInto(Operations& table);

private:
    Reply store(const Request& request);
    Reply storeMaster(const Request& request);
    Reply retrieve(const Request& request);
    Reply retrieveItems(const Request& request);
    Reply exists(const Request& request);
    Reply lastModifiedTime(const Request& request);
    Reply listItems(const Request& request);

    std::int64_t storeHere(const Request& request, const std::string& bytes, std::int64_t time);

    // Documents from this size on keep their Base64 text between retrieves, up to the budget.
    static constexpr std::size_t kCachedBase64From = 1024;
    static constexpr std::size_t kCachedBase64Budget = 64u << 20;

    ServiceContext& m_context;
    Base64Cache m_base64;
};

}  // namespace ConfigurationService
