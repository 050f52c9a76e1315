// The records and result sources of one document, in SI. Controllers read; CEditData writes.
#pragma once

#include "qm_db/modelstore.h"

/// Table of a record type: nodes for T_NODE_D, and so on.
template <class T>
T_TABLE<T>& TableOf(T_MODEL& model);
template <>
inline T_TABLE<T_NODE_D>& TableOf(T_MODEL& m)
{
    return m.nodes;
}
template <>
inline T_TABLE<T_STOR_D>& TableOf(T_MODEL& m)
{
    return m.storeys;
}
template <>
inline T_TABLE<T_EIGV_D>& TableOf(T_MODEL& m)
{
    return m.modes;
}
template <>
inline T_TABLE<T_SPFC_D>& TableOf(T_MODEL& m)
{
    return m.spectra;
}
template <>
inline T_TABLE<T_POLC_D>& TableOf(T_MODEL& m)
{
    return m.pushovers;
}
template <>
inline T_TABLE<T_EVAL_D>& TableOf(T_MODEL& m)
{
    return m.evaluations;
}
template <>
inline T_TABLE<T_POVR_D>& TableOf(T_MODEL& m)
{
    return m.poverSteps;
}

class CDataCtrl {
public:
    const T_MODEL& Model() const { return m_content.model; }
    const T_MODEL_CONTENT& Content() const { return m_content; }
    const T_UNITS& Units() const { return m_content.model.styp.units; }

    /// Replaces the whole content; the document counts as unmodified.
    void Assign(T_MODEL_CONTENT content);
    /// Replaces or adds the results of one pushover load case.
    void SetResult(int pushover, std::shared_ptr<IPushResult> result);

    bool IsModified() const { return m_modified; }
    void SetModified(bool modified) { m_modified = modified; }
    /// Grows with every change; lets readers keep derived values until something changed.
    long Revision() const { return m_revision; }

    /// Stores the limit-state steps of a load case. They derive from the rest, so the revision
    /// stays; the document counts as modified only when they differ from what is stored.
    void SetPoverSteps(int pushover, const T_POVR_D& steps);

    /// For CEditData and CUndoCtrl only: the model to change; marks the document modified.
    T_MODEL& ModelForEdit();

private:
    T_MODEL_CONTENT m_content;
    bool m_modified = false;
    long m_revision = 0;
};
