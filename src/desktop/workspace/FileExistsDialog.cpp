#include "desktop/workspace/FileExistsDialog.h"

#include <QHBoxLayout>
#include <QLabel>
#include <QPushButton>
#include <QVBoxLayout>

FileExistsDialog::FileExistsDialog(QWidget* parent) : QDialog(parent) {
    setObjectName(QStringLiteral("frmAppendRenameOverwrite"));
    setWindowTitle(QString());
    setModal(true);

    auto* label = new QLabel(QStringLiteral("The  file  you  specified  already  exists.    "
                                            "Please  select  one  of  the following  options."),
                             this);
    label->setObjectName(QStringLiteral("Label1"));
    label->setWordWrap(true);

    struct Button {
        const char* name;
        const char* caption;
        const char* choice;
    };
    auto* buttons = new QHBoxLayout;
    for (const Button& b : {Button{"cmdAppend", "&Append", "Append"},
                            Button{"cmdOverwrite", "&Overwrite", "Overwrite"},
                            Button{"cmdRename", "&Rename", "Rename"}}) {
        auto* button = new QPushButton(QString::fromLatin1(b.caption), this);
        button->setObjectName(QString::fromLatin1(b.name));
        button->setAutoDefault(false);
        const QString choice = QString::fromLatin1(b.choice);
        connect(button, &QPushButton::clicked, this, [this, choice] { choose(choice); });
        buttons->addWidget(button);
    }

    auto* layout = new QVBoxLayout(this);
    layout->addWidget(label);
    layout->addLayout(buttons);
    setFixedWidth(420);
}

void FileExistsDialog::choose(const QString& choice) {
    choice_ = choice;
    accept();
}
