// What the pushover tools of a document share.
#pragma once

#include "qm_base/dynmodule.h"

/// State: the load case that was chosen last. Lives in the document's module registry.
class CPushoverManager : public CDynModule {
public:
    /// In the module registry.
    static constexpr const char* kName = "CPushoverManager";
    /// That of the current document, made when it is first asked for; null without a document.
    static CPushoverManager* Current();

    /// Key of the pushover load case that was chosen last; 0: none. It may be gone meanwhile.
    int m_loadCase = 0;
};
