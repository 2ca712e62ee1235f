#include "frmWait.h"

#include <QLabel>
#include <QVBoxLayout>

namespace verbloom {

frmWait::frmWait(QWidget *parent)
    : QWidget(parent, Qt::Dialog | Qt::CustomizeWindowHint | Qt::WindowTitleHint)
{
    setObjectName(u"frmWait"_qs);
    setWindowTitle(u"Verbloom"_qs);
    auto *label = new QLabel(u"Please Wait ....."_qs, this);
    label->setObjectName(u"lblWait"_qs);
    label->setAlignment(Qt::AlignCenter);
    QFont font = label->font();
    font.setPointSizeF(font.pointSizeF() * 1.4);
    label->setFont(font);
    auto *layout = new QVBoxLayout(this);
    layout->setContentsMargins(40, 24, 40, 24);
    layout->addWidget(label);
    setFixedSize(sizeHint());
}

} // namespace verbloom
