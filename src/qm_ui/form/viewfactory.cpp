#include "qm_ui/form/viewfactory.h"

const T_VIEW* CViewFactory::Find(const zql::frx::MDialog& model) const
{
    const auto it = m_views.find(typeid(model));
    return it == m_views.end() ? nullptr : &it->second;
}
