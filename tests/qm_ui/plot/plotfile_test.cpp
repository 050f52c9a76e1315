#include "qm_ui/plot/plotfile.h"

#include "tempfolder.h"
#include "testapp.h"

#include <QImage>
#include <QString>
#include <QSvgRenderer>
#include <gtest/gtest.h>

#include <filesystem>
#include <string>

namespace {

namespace fs = std::filesystem;

T_PLOT Plot()
{
    T_PLOT plot;
    plot.title = "Capacity & demand";
    plot.series.push_back({"Base shear", {0, 1, 2, 3}, {0, 6, 8, 9}});
    plot.series[0].color = T_PLOT_COLOR{255, 0, 0};
    plot.series[0].width = 4.0;
    plot.labels.push_back({2, 8, "yield"});
    return plot;
}

class PlotFile : public testing::Test {
protected:
    std::string Path(const char* name) const { return m_folder / name; }
    std::size_t Count() const { return m_folder.Names().size(); }

    CTempFolder m_folder;
    std::string m_error = "old";
};

TEST_F(PlotFile, PngHoldsTheCurve)
{
    ASSERT_EQ(1, WritePlotFile(Plot(), Path("a.PNG"), m_error)) << m_error;
    const QImage image(QString::fromStdString(Path("a.PNG")));
    ASSERT_EQ(QSize(1920, 1280), image.size());
    EXPECT_EQ(qRgb(255, 255, 255), image.pixel(2, 2));
    int red = 0;
    for (int y = 0; y < image.height(); ++y)
        for (int x = 0; x < image.width(); ++x)
            red += image.pixel(x, y) == qRgb(255, 0, 0) ? 1 : 0;
    EXPECT_GT(red, 1000);
    EXPECT_EQ(1u, Count());
}

TEST_F(PlotFile, SvgLoadsAndHoldsTheTitle)
{
    ASSERT_EQ(1, WritePlotFile(Plot(), Path("a.svg"), m_error)) << m_error;
    const std::string text = ReadText(Path("a.svg"));
    EXPECT_NE(std::string::npos, text.find("<title>Capacity &amp; demand</title>"));
    EXPECT_NE(std::string::npos, text.find("yield</text>"));
    NeedApp();
    const QSvgRenderer svg(QString::fromStdString(Path("a.svg")));
    EXPECT_TRUE(svg.isValid());
    EXPECT_EQ(QRectF(0, 0, 960, 640), svg.viewBoxF());
    EXPECT_EQ(1u, Count());
}

TEST_F(PlotFile, WhatCanNotBeWrittenIsRefusedAndLeavesNothing)
{
    fs::create_directory(Path("folder.svg"));
    for (const char* name : {"a.gif", "a", "svg", "a.svg.txt", "missing/a.svg", "missing/a.png",
                             "missing/a.pdf", "folder.svg"}) {
        EXPECT_EQ(0, WritePlotFile(Plot(), Path(name), m_error));
        EXPECT_NE(std::string::npos, m_error.find(Path(name))) << m_error;
    }
    EXPECT_EQ(1u, Count());
    EXPECT_TRUE(fs::is_empty(Path("folder.svg")));
}

} // namespace
