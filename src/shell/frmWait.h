#pragma once

#include <QWidget>

namespace verbloom {

/// The small window shown while a cancelled analysis unwinds: "Please Wait .....".
class frmWait final : public QWidget
{
    Q_OBJECT

public:
    explicit frmWait(QWidget *parent = nullptr);
};

} // namespace verbloom
