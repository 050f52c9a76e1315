// Through this the host asks for the report data of the current document.
#pragma once

#include <string>

/// What the host asks; see IRPSInterfaceImpl.
class IRPSInterface {
public:
    IRPSInterface() = default;
    IRPSInterface(const IRPSInterface&) = delete;
    IRPSInterface& operator=(const IRPSInterface&) = delete;
    virtual ~IRPSInterface() = default;
    /// Builds a fresh report data set and hands it to the document's CRPSManager. 1 done; 0 no
    /// document, or its data can't be read.
    [[nodiscard]] virtual int BuildReport() = 0;
};

class IRPSInterfaceImpl : public IRPSInterface {
public:
    [[nodiscard]] int BuildReport() override;
    /// Why the last one could not be built; empty after a success.
    const std::string& Error() const { return m_error; }

private:
    std::string m_error;
};
