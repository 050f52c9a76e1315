// Evaluates one evaluation of a case file with the installed library and prints the point.
#include "qm_db/dbdoc.h"
#include "qm_rps/pushovercurvedlg.h"

#include <cstdio>

int main(int argc, char** argv)
{
    if (argc != 2) return 2;
    CDBDoc doc;
    T_FILE_ERROR error;
    if (!doc.ImportCase(argv[1], error)) {
        std::fprintf(stderr, "%s\n", error.text.c_str());
        return 1;
    }
    CPushOverCurveDlg driver(doc);
    T_EVAL_D evaluation;
    if (!doc.Attr().GetEval(1, evaluation) || !driver.SetEvaluation(evaluation)) return 1;
    const int result = driver.Evaluate();
    if (!driver.Result().point) return 1;
    std::printf("result %d Sd %.4f\n", result, driver.Result().point->Sd);
    return 0;
}
