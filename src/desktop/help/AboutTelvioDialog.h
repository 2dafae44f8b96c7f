#pragma once

#include <QDialog>
#include <QString>

// frmAboutTelvio: the program's about box with its version.
class AboutTelvioDialog : public QDialog {
    Q_OBJECT
public:
    explicit AboutTelvioDialog(QWidget* parent = nullptr);

    // "Version : v" + major + "." + minor.
    static QString versionText();
};
