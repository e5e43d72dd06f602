#pragma once

#include "LogGenerator/Template/SectionRegistry.h"

#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

namespace spectrel {

/// The registry of one technology's sections: by section name, and by the log codes they subscribed to.
///
/// A concrete index holds its sections as members, declared in the order of creation, which is the order of delivery:
/// `SimInfo objSimInfo {*this};`
class ClassIndex : protected SectionRegistry {
public:
    explicit ClassIndex(const Context& given = {});
    ClassIndex(const ClassIndex&) = delete;
    ClassIndex& operator=(const ClassIndex&) = delete;
    /// Writes "Deallocing ClassIndex" to the console.
    virtual ~ClassIndex();

    /// The section of that name; null when there is none.
    Base* getClass(std::string_view name) const;
    /// The sections to call for a record of the code, in order; null when nobody subscribed.
    const Subscribers* getSubscribers(std::uint32_t logCode) const
    {
        return codeDictionary.subscribers(logCode);
    }
    /// The registered codes as decimal texts, in the order of their first registration.
    std::vector<std::string> getAllLogCodes() const;
    /// A self-check that logs two lines and always answers 1 and 0.
    void status() const;
};

} // namespace spectrel
