#include "AppStyle.h"

#include <QApplication>
#include <QIcon>
#include <QPalette>
#include <QStyle>
#include <QStyleFactory>

namespace verbloom {

namespace {

constexpr QStringView StyleSheet = u""
    // Main window
    "#frmMain { background: #eef1f6; }"
    "#fraButtons { background: qlineargradient(x1:0, y1:0, x2:0, y2:1, stop:0 #1b2740, stop:1 #24365a);"
    "              border: none; }"
    "#fraF { background: transparent; border: none; }"
    "#lblArticle, #lblConfiguration, #lblVerify { font-size: 16pt; font-weight: 600; color: #1b2740; }"
    "#Picture1, #Picture2, #verifyCard { background: white; border: 1px solid #d6dce6; border-radius: 8px; }"
    "#pctMain\\(2\\) { background: #eef1f6; }"
    "QLineEdit, QPlainTextEdit, QComboBox, QTreeWidget {"
    "    border: 1px solid #c5cedb; border-radius: 4px; background: white; padding: 3px;"
    "    selection-background-color: #3f86e0; }"
    "QLineEdit:focus, QPlainTextEdit:focus, QComboBox:focus, QTreeWidget:focus { border-color: #3f86e0; }"
    "QHeaderView::section { background: #f3f5f9; border: none; border-bottom: 1px solid #d6dce6;"
    "    padding: 4px 6px; font-weight: 600; color: #33415c; }"
    "#lblExplain1, #lblExplain2, #lblExplain3 { color: #4a5870; }"
    // Splash window
    "#frmSplash #Picture1 { background: qlineargradient(x1:0, y1:0, x2:1, y2:1, stop:0 #ffffff, stop:1 #e4ecf8);"
    "    border: 1px solid #9fb3d1; border-radius: 0; }"
    "#lblLogo { font-size: 34pt; font-weight: 700; color: #24497f; }"
    "#lblLogoShadow { font-size: 34pt; font-weight: 700; }"
    "#lblTagline { font-size: 11pt; color: #4a5870; }"
    "#lblCompanyNM { font-size: 12pt; font-weight: 600; color: #1b2740; }"
    "#lblWebSiteURL { color: #24497f; }"
    "#lblLegal { font-size: 8pt; color: #6b778c; }"
    "#lblLoading { font-weight: 600; color: #24497f; }"
    // Web page loader
    "#frmOpenURL #Picture1 { background: white; border: none; border-bottom: 1px solid #d6dce6;"
    "    border-radius: 0; }"
    "#lblNote { color: #6b778c; }"
    "QProgressBar { border: none; background: #e4e9f1; }"
    "QProgressBar::chunk { background: #3f86e0; }"
    "#frmWait { background: white; }"
    "#lblWait { color: #24497f; font-weight: 600; }";

} // namespace

void ApplyAppStyle(QApplication &app)
{
    app.setStyle(QStyleFactory::create(u"Fusion"_qs));
    QPalette palette = app.style()->standardPalette();
    palette.setColor(QPalette::Window, QColor(0xee, 0xf1, 0xf6));
    palette.setColor(QPalette::Highlight, QColor(0x3f, 0x86, 0xe0));
    palette.setColor(QPalette::ToolTipBase, QColor(0xff, 0xfb, 0xe6));
    palette.setColor(QPalette::ToolTipText, QColor(0x1b, 0x27, 0x40));
    app.setPalette(palette);
    app.setStyleSheet(StyleSheet.toString());
    app.setWindowIcon(QIcon(u":/icons/verbloom.png"_qs));
}

} // namespace verbloom
