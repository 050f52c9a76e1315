// The tables of the explorer, one maker each.
#pragma once

#include "qm_rps/desk/recordgrid.h"

std::unique_ptr<CRecordGrid> MakeNodeGrid(CDBDoc& doc, const char* title);
std::unique_ptr<CRecordGrid> MakeElementGrid(CDBDoc& doc, const char* title);
std::unique_ptr<CRecordGrid> MakeSectionGrid(CDBDoc& doc, const char* title);
std::unique_ptr<CRecordGrid> MakeMaterialGrid(CDBDoc& doc, const char* title);
std::unique_ptr<CRecordGrid> MakeStoreyGrid(CDBDoc& doc, const char* title);
std::unique_ptr<CRecordGrid> MakeLoadCaseGrid(CDBDoc& doc, const char* title);
std::unique_ptr<CRecordGrid> MakeCombinationGrid(CDBDoc& doc, const char* title);
std::unique_ptr<CRecordGrid> MakeStageGrid(CDBDoc& doc, const char* title);
std::unique_ptr<CRecordGrid> MakePushoverGrid(CDBDoc& doc, const char* title);
std::unique_ptr<CRecordGrid> MakeHingeTypeGrid(CDBDoc& doc, const char* title);
std::unique_ptr<CRecordGrid> MakeHingeGrid(CDBDoc& doc, const char* title);
std::unique_ptr<CRecordGrid> MakeSpectrumGrid(CDBDoc& doc, const char* title);
std::unique_ptr<CRecordGrid> MakeEvaluationGrid(CDBDoc& doc, const char* title);
std::unique_ptr<CRecordGrid> MakeConstraintGrid(CDBDoc& doc, const char* title);
std::unique_ptr<CRecordGrid> MakeUlfItemGrid(CDBDoc& doc, const char* title);
std::unique_ptr<CRecordGrid> MakeStageItemGrid(CDBDoc& doc, const char* title);
std::unique_ptr<CRecordGrid> MakeModeGrid(CDBDoc& doc, const char* title);
std::unique_ptr<CRecordGrid> MakeDiaphragmGrid(CDBDoc& doc, const char* title);
std::unique_ptr<CRecordGrid> MakeEqualGrid(CDBDoc& doc, const char* title);
std::unique_ptr<CRecordGrid> MakeInelasticGrid(CDBDoc& doc, const char* title);
std::unique_ptr<CRecordGrid> MakeFunctionGrid(CDBDoc& doc, const char* title);
std::unique_ptr<CRecordGrid> MakeLimitStepGrid(CDBDoc& doc, const char* title);
