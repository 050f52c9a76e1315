// Per-document registry of named module objects, created by whoever needs them first.
#pragma once

#include <map>
#include <memory>
#include <string>
#include <string_view>

class CDynModule {
public:
    CDynModule() = default;
    CDynModule(const CDynModule&) = delete;
    CDynModule& operator=(const CDynModule&) = delete;
    virtual ~CDynModule() = default;
};

class CDynModuleMgr {
public:
    /// The module registered under `name`, or null. The registry keeps ownership.
    CDynModule* GetDynModule(std::string_view name) const;

    /// Registers a module. 1 done; 0 when the name is taken, empty, or the module is null.
    [[nodiscard]] int AddDynModule(std::string_view name, std::unique_ptr<CDynModule> module);

private:
    std::map<std::string, std::unique_ptr<CDynModule>, std::less<>> m_modules;
};
