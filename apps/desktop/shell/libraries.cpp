#include "shell/libraries.h"

#include <QtGlobal>

#define POINTERHOLDER_TRANSITION 4 // std::shared_ptr in the interface of qpdf
#include <Eigen/src/Core/util/Macros.h>
#include <Spectra/Util/Version.h>
#include <coin/ClpConfig.h>
#include <dmumps_c.h>
#include <metis.h>
#include <nlohmann/detail/abi_macros.hpp>
#include <qpdf/QPDF.hh>
#include <sqlite3.h>

extern "C" char* openblas_get_config(void);

namespace {

std::string Numbers(int a, int b, int c)
{
    return std::to_string(a) + "." + std::to_string(b) + "." + std::to_string(c);
}

/// "OpenBLAS 0.3.21 NO_LAPACKE ..." -> "0.3.21".
std::string OpenBlasVersion()
{
    const std::string config = openblas_get_config();
    const std::size_t from = config.find(' ') + 1;
    return config.substr(from, config.find(' ', from) - from);
}

} // namespace

std::vector<T_LIBRARY> UsedLibraries()
{
    return {
        {"Qt", qVersion(), "LGPL-3.0"},
        {"SQLite", sqlite3_libversion(), "public domain"},
        {"nlohmann-json",
         Numbers(NLOHMANN_JSON_VERSION_MAJOR, NLOHMANN_JSON_VERSION_MINOR,
                 NLOHMANN_JSON_VERSION_PATCH),
         "MIT"},
        {"MUMPS", MUMPS_VERSION, "CeCILL-C"},
        {"METIS", Numbers(METIS_VER_MAJOR, METIS_VER_MINOR, METIS_VER_SUBMINOR), "Apache-2.0"},
        {"OpenBLAS", OpenBlasVersion(), "BSD-3-Clause"},
        {"Eigen", Numbers(EIGEN_WORLD_VERSION, EIGEN_MAJOR_VERSION, EIGEN_MINOR_VERSION),
         "MPL-2.0"},
        {"Spectra", Numbers(SPECTRA_MAJOR_VERSION, SPECTRA_MINOR_VERSION, SPECTRA_PATCH_VERSION),
         "MPL-2.0"},
        {"Clp", CLP_VERSION, "EPL-1.0"},
        {"qpdf", QPDF::QPDFVersion(), "Apache-2.0"},
        {"DejaVu Sans", "", "Bitstream Vera"},
    };
}
