// What the iterative analysis for pretension asks of the program around it.
#pragma once

#include "qm_rps/factors/ulfiterationreport.h"

/// One model and its construction-stage problem. A refused operation (0) has told the person why.
class IUlfIterationHost {
public:
    IUlfIterationHost() = default;
    IUlfIterationHost(const IUlfIterationHost&) = delete;
    IUlfIterationHost& operator=(const IUlfIterationHost&) = delete;
    virtual ~IUlfIterationHost() = default;

    virtual std::string ModelPath() const = 0;
    /// Finds the factors of the unknowns with the results at hand, in the order of the problem.
    [[nodiscard]] virtual int Solve(std::vector<T_ULF_ITER_ROW>& rows) = 0;
    /// Saves the model under another name, which becomes its own.
    [[nodiscard]] virtual int SaveCopy(const std::string& path) = 0;

    /// An edit that can be undone: everything between start and close, or nothing when cancelled.
    [[nodiscard]] virtual int StartEdit(const std::string& title) = 0;
    /// Multiplies the pretension loads that the unknown scales; one without any is done at once.
    [[nodiscard]] virtual int ScalePretension(std::size_t unknown, double factor) = 0;
    [[nodiscard]] virtual int CloseEdit() = 0;
    virtual void CancelEdit() = 0;
    /// Takes the latest closed edit back, and what an analysis has found since.
    virtual void UndoEdit() = 0;

    /// Starts the analysis; IsExcuted while it runs, DispatchEvents keeps the window alive (all
    /// but closing it and system commands). The model is in post mode once results of it as it is
    /// are there. The host keeps results with the model's file.
    [[nodiscard]] virtual int StartAnalysis() = 0;
    virtual bool IsExcuted() = 0;
    /// Asks the analysis that is running to end without results; it may have ended already.
    virtual void CancelAnalysis() = 0;
    virtual void DispatchEvents() = 0;
    virtual bool IsPostMode() = 0;
};
