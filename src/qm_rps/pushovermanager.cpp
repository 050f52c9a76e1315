#include "qm_rps/pushovermanager.h"

#include "qm_rps/desk/docmodule.h"

CPushoverManager* CPushoverManager::Current()
{
    return CurrentDocModule<CPushoverManager>("src/qm_rps/pushovermanager");
}
