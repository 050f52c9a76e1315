// Modules of this library in a document's registry, made when they are first asked for.
#pragma once

#include "qm_base/appbase.h"
#include "qm_db/dbdoc.h"

/// The document's module that is registered under MODULE::kName. Null, and the release assertion
/// for `source`, where something else has that name.
template <class MODULE>
MODULE* DocModule(CDBDoc& doc, const char* source)
{
    CDynModuleMgr& modules = doc.DynModules();
    if (!modules.GetDynModule(MODULE::kName))
        (void)modules.AddDynModule(MODULE::kName, std::make_unique<MODULE>());
    auto* module = dynamic_cast<MODULE*>(modules.GetDynModule(MODULE::kName));
    if (!module && CAppBase::IsReleaseAssert_ST()) CAppBase::ReleaseAssertion_ST(source, __LINE__);
    return module;
}

/// That of the current document; null, and nothing is registered, where there is none.
template <class MODULE>
MODULE* CurrentDocModule(const char* source)
{
    CDBDoc* doc = CDBDoc::GetDocPoint();
    return doc ? DocModule<MODULE>(*doc, source) : nullptr;
}
