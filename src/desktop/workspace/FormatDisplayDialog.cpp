#include "desktop/workspace/FormatDisplayDialog.h"

#include "core/settings/AppState.h"

#include <QGroupBox>
#include <QHBoxLayout>
#include <QLabel>
#include <QPushButton>
#include <QRadioButton>
#include <QVBoxLayout>

namespace {
struct Frame {
    const char* caption;
    const char* yesName;
    const char* noName;
    const char* note;
};

const Frame kFrames[3] = {
    {"Convert  asterisks  to  decimal  point", "Option1", "Option2",
     "*   Conversion  is  performed               when  data  is  saved  to  file.         "
     "(Useful  for  spreadsheets)."},
    {"Convert  mS/cm  to  uS/cm", "Option3", "Option4",
     "*   Conversion  is  performed               when  download  from                      "
     "instrument  is  complete."},
    {"Convert  ppK  to  ppM", "Option5", "Option6",
     "*   Conversion  is  performed         when  download  from                 "
     "instrument  is  complete."},
};
} // namespace

FormatDisplayDialog::FormatDisplayDialog(AppState& state, QWidget* parent)
    : QDialog(parent), state_(state) {
    setObjectName(QStringLiteral("frmFormatDisplay"));
    setWindowTitle(QStringLiteral("  Data  Conversions"));
    setModal(true);

    const qint16 settings[3] = {state.convertAsterisks, state.convertMsToUs, state.convertPpkToPpm};
    auto* layout = new QVBoxLayout(this);
    for (int i = 0; i < 3; ++i) {
        auto* row = new QHBoxLayout;
        auto* box = new QGroupBox(QString::fromLatin1(kFrames[i].caption), this);
        box->setObjectName(QStringLiteral("Frame%1").arg(i + 1));
        auto* yes = new QRadioButton(QStringLiteral("Yes"), box);
        yes->setObjectName(QString::fromLatin1(kFrames[i].yesName));
        auto* no = new QRadioButton(QStringLiteral("No"), box);
        no->setObjectName(QString::fromLatin1(kFrames[i].noName));
        (settings[i] == 1 ? yes : no)->setChecked(true);
        auto* buttons = new QHBoxLayout(box);
        buttons->addWidget(yes);
        buttons->addWidget(no);
        yes_[i] = yes;

        auto* note = new QLabel(QString::fromLatin1(kFrames[i].note), this);
        note->setObjectName(QStringLiteral("lblNote%1").arg(i + 1));
        note->setWordWrap(true);
        note->setFixedWidth(230);
        row->addWidget(box, 1);
        row->addWidget(note);
        layout->addLayout(row);
    }

    auto* ok = new QPushButton(QStringLiteral("&OK"), this);
    ok->setObjectName(QStringLiteral("cmdOK"));
    ok->setDefault(true);
    auto* cancel = new QPushButton(QStringLiteral("&Cancel"), this);
    cancel->setObjectName(QStringLiteral("cmdCancel"));
    auto* buttons = new QHBoxLayout;
    buttons->addStretch();
    buttons->addWidget(ok);
    buttons->addWidget(cancel);
    layout->addLayout(buttons);

    connect(ok, &QPushButton::clicked, this, [this] {
        storeChoices();
        accept();
    });
    connect(cancel, &QPushButton::clicked, this, &QDialog::reject);
}

void FormatDisplayDialog::storeChoices() {
    state_.convertAsterisks = yes_[0]->isChecked() ? 1 : 0;
    state_.convertMsToUs = yes_[1]->isChecked() ? 1 : 0;
    state_.convertPpkToPpm = yes_[2]->isChecked() ? 1 : 0;
}
