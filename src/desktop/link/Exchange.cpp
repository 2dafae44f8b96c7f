#include "desktop/link/Exchange.h"

#include "core/settings/AppState.h"
#include "desktop/link/CommErrorDialog.h"
#include "desktop/link/Connection.h"
#include "desktop/link/CpuOverUseDialog.h"
#include "desktop/shell/MainWindow.h"

#include <QAction>
#include <QLabel>
#include <QMenu>
#include <QPlainTextEdit>
#include <QProgressBar>
#include <QPushButton>
#include <QTimer>

Exchange::Exchange(MainWindow& window)
    : CommandExchange(window.state(), window.serial(), window.clock(), window.prompts(), *this),
      w_(window) {}

double Exchange::replyWindowSeconds() const {
    const QString message = w_.controls().lblMessage->text();
    if (message.left(16) == QLatin1String("Device  detected") ||
        message.left(8) == QLatin1String("Shutting"))
        return 12.0;
    return 2.0;
}

void Exchange::endProgress() {
    w_.setMessage(QString());
    w_.controls().ProgressBar1->hide();
}

void Exchange::linkReset() {
    const MainControls& c = w_.controls();
    c.tmrDetectMeter->stop();
    c.cmdHelp->setEnabled(true);
    c.cmdOpenFile->setEnabled(true);
    c.cmdSaveFile->setEnabled(false);
    c.cmdCurrentData->setEnabled(false);
    c.cmdCurrentData->show();
    c.cmdStopCurrentData->hide();
    for (QPushButton* b : {c.cmdLoggedData, c.cmdGLPData, c.cmdEnableLogging, c.cmdStartStirring,
                           c.cmdStopStirring, c.cmdDisableLogging, c.cmdEraseLog, c.cmdListen})
        b->setEnabled(false);
    c.mnuDetectMeter->setEnabled(true);
    c.mnuDisplay->setEnabled(false);
    c.mnuEraseLog->setVisible(false);
    c.mnuFile->setEnabled(true);
    c.mnuSetup->setEnabled(true);
    c.mnuHelp->setEnabled(true);
    c.mnuSave->setEnabled(false);

    for (QLabel* l : {c.lblModelData, c.lblVersionData, c.lblSerialData, c.lblNumLogData})
        l->clear();
    c.lblHeader->hide();
    w_.setMessage(QString());
    c.ProgressBar1->hide();
    w_.setEnabled(true);
    w_.repaint();

    if (c.mnuRealTime->isChecked()) {
        // The real-time table stays whole in the workspace; only the view is brought up to date
        // and the newest line put in view.
        if (c.RichTextBox1->toPlainText() != s_.workspaceText)
            c.RichTextBox1->setPlainText(s_.workspaceText);
        c.RichTextBox1->moveCursor(QTextCursor::End);
    }
}

void Exchange::ShowCommError() {
    if (commErrorOpen_)
        return;
    commErrorOpen_ = true;
    const MainControls& c = w_.controls();
    endProgress();
    CommErrorDialog::Choice choice = CommErrorDialog::Choice::Cancel;
    {
        CommErrorDialog dialog(&w_);
        dialog.exec();
        choice = dialog.choice();
    }
    commErrorOpen_ = false;
    s_.abortRequested = false;
    switch (choice) {
    case CommErrorDialog::Choice::Retry:
        ResetLink();
        w_.connection().ConnectMeter();
        break;
    case CommErrorDialog::Choice::Setup:
        ResetLink();
        w_.connection().ShowCommsPortDialog();
        break;
    case CommErrorDialog::Choice::Cancel:
        c.mnuDetectMeter->setEnabled(true);
        ResetLink();
        break;
    }
}

void Exchange::ShowCpuOverUse() {
    w_.setMessage(QString());
    CpuOverUseDialog dialog(&w_);
    dialog.exec();
}
