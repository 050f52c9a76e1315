// What the iterative analysis for pretension asks of the program and of the person around it.
#pragma once

#include "qm_base/finding.h"
#include "qm_rps/factors/ulfiterationreport.h"

#include <optional>

/// One model and its construction-stage problem.
class IUlfIterationHost {
public:
    IUlfIterationHost() = default;
    IUlfIterationHost(const IUlfIterationHost&) = delete;
    IUlfIterationHost& operator=(const IUlfIterationHost&) = delete;
    virtual ~IUlfIterationHost() = default;

    virtual std::string ModelPath() const = 0;
    /// Finds the factors of the unknowns with the results at hand, in the order of the problem.
    /// said: why there are none, or which constraints they miss; empty: nothing.
    [[nodiscard]] virtual int Solve(std::vector<T_ULF_ITER_ROW>& rows,
                                    std::optional<T_FINDING>& said) = 0;
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

    /// Starts the analysis; IsExcuted while it runs, Wait gives it a little time. The model is in
    /// post mode once results of it as it is are there. The host keeps results with the model's
    /// file.
    [[nodiscard]] virtual int StartAnalysis() = 0;
    virtual bool IsExcuted() = 0;
    /// Asks the analysis that is running to end without results; it may have ended already.
    virtual void CancelAnalysis() = 0;
    virtual void Wait() = 0;
    virtual bool IsPostMode() = 0;
};

/// What a person wants after a solution.
enum class ULF_ITER_WISH {
    Stop,
    Iterate,
    IterateUnasked, // and not be asked again in this run
};

/// Who the run is made for.
class IUlfIterationPerson {
public:
    IUlfIterationPerson() = default;
    IUlfIterationPerson(const IUlfIterationPerson&) = delete;
    IUlfIterationPerson& operator=(const IUlfIterationPerson&) = delete;
    virtual ~IUlfIterationPerson() = default;

    /// Each solution, with what there is to say about it, before Wish.
    virtual void Solved(const T_ULF_ITER_STEP& step, const std::optional<T_FINDING>& said) = 0;
    virtual ULF_ITER_WISH Wish(const T_ULF_ITER_STEP& step) = 0;
    /// May the report that stands there be overwritten? Else it is added to.
    virtual bool MayOverwrite(const std::string& report) = 0;
    /// May a model that has the name of a copy be overwritten? Asked before the first one that is
    /// there; the answer goes for all copies of the run.
    virtual bool MayReplace(const std::string& copy) = 0;
    /// Told before each iteration, and again and again while its analysis runs (so that a window
    /// stays alive), with the number of those done; false cancels the run, the model and its file
    /// being as after the last complete iteration.
    virtual bool GoesOn(int done, int required) = 0;
};
