// Head office of services: modules register an agency by name, others ask it for a service.
#pragma once

#include <map>
#include <memory>
#include <string>
#include <string_view>

/// A request to an agency: kind, then the values that this kind needs.
struct T_SERVICE_REQUEST {
    int kind = 0;
    int index = 0;          // kind 1: hinge component index
    int key = 0;            // kind 1: key of the record
    int mode = 0;           // kind 1: mode value
    void* record = nullptr; // kind 1: the caller's record, owned by the caller
    void* rows = nullptr;   // kind 2: the caller's list of rows, owned by the caller
};

class CServiceAgency {
public:
    CServiceAgency() = default;
    CServiceAgency(const CServiceAgency&) = delete;
    CServiceAgency& operator=(const CServiceAgency&) = delete;
    virtual ~CServiceAgency() = default;
    /// 1 done and accepted; 0 cancelled or nothing to do.
    virtual int Service(const T_SERVICE_REQUEST& request) = 0;
};

class CServiceHeadOffice {
public:
    static CServiceHeadOffice* Instance();

    /// 1 registered; 0 when the name is empty or taken, or the agency is null.
    [[nodiscard]] int RegAgency(std::string_view name, std::unique_ptr<CServiceAgency> agency);
    /// The agency of that name, or null. The head office keeps ownership.
    CServiceAgency* GetAgency(std::string_view name) const;

private:
    std::map<std::string, std::unique_ptr<CServiceAgency>, std::less<>> m_agencies;
};
