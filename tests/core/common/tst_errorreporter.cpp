// Veltrix — KPI dashboard for small businesses.
#include "common/errorreporter.h"
#include "common/recordingprompter.h"

#include <QTest>

using namespace Qt::StringLiterals;

class TestErrorReporter : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void reports_data();
    void reports();
};

void TestErrorReporter::reports_data()
{
    QTest::addColumn<int>("number");
    QTest::addColumn<QString>("description");
    QTest::addColumn<QString>("context");
    QTest::addColumn<QString>("text");
    QTest::addColumn<QString>("title");

    QTest::newRow("no error shows nothing")
        << 0 << u"ignored"_s << u"Logoff"_s << QString() << QString();
    const QString communication = u"Could not communicate with database. Check the network "
                                  u"connection and ensure the database server is switched on."_s;
    QTest::newRow("database unreachable")
        << -2147467259 << u"Disk or network error."_s << u"Connection"_s << communication
        << u"Communication Error"_s;
    QTest::newRow("ordinary error")
        << 3021 << u"No current record."_s << u"Find Record"_s
        << u"Error 3021\r\n\r\nNo current record."_s << u"Find Record Error 3021"_s;
    QTest::newRow("negative number keeps its sign")
        << -2147217900 << u"Syntax error."_s << u"Produce"_s
        << u"Error -2147217900\r\n\r\nSyntax error."_s << u"Produce Error -2147217900"_s;
    // A server or file may hand on anything as a description; the box stays readable.
    QTest::newRow("a megabyte of description is cut")
        << 13 << QString(1 << 20, u'x') << u"GetMWValue"_s
        << u"Error 13\r\n\r\n"_s + QString(400 - 12, u'x') + u"…"_s << u"GetMWValue Error 13"_s;
    QTest::newRow("a thousand lines are cut to twelve")
        << 13 << u"line\n"_s.repeated(1000) << u"GetMWJobs"_s
        << u"Error 13\r\n\r\n"_s + u"line\n"_s.repeated(9) + u"line…"_s << u"GetMWJobs Error 13"_s;
    QTest::newRow("a long context cuts the title")
        << 5 << u"x"_s << QString(300, u'c') << u"Error 5\r\n\r\nx"_s
        << QString(100, u'c') + u"…"_s;
    QTest::newRow("no half character at the cut")
        << 5 << QString(388, u'x') + u"😀😀"_s << u"Produce"_s
        << u"Error 5\r\n\r\n"_s + QString(388, u'x') + u"…"_s << u"Produce Error 5"_s;
}

void TestErrorReporter::reports()
{
    QFETCH(int, number);
    QFETCH(QString, description);
    QFETCH(QString, context);
    QFETCH(QString, text);
    QFETCH(QString, title);

    RecordingPrompter prompter;
    prompter.setBusyPointer();
    ErrorReporter(prompter).reportError(number, description, context);
    // The user is not left looking at an hourglass while reading.
    QCOMPARE(prompter.isBusy(), text.isEmpty());
    QCOMPARE(prompter.messages().size(), text.isEmpty() ? 0 : 1);
    if (text.isEmpty())
        return;
    QCOMPARE(prompter.messages().first().text, text);
    QCOMPARE(prompter.messages().first().title, title);
    QCOMPARE(prompter.messages().first().icon, Prompter::Icon::Exclamation);
    QCOMPARE(prompter.messages().first().buttons, Prompter::Buttons::Ok);
}

QTEST_GUILESS_MAIN(TestErrorReporter)
#include "tst_errorreporter.moc"
