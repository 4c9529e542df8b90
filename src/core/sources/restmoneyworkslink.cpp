// Veltrix — KPI dashboard for small businesses.
#include "restmoneyworkslink.h"

#include <QEventLoop>
#include <QNetworkAccessManager>
#include <QNetworkReply>
#include <QSaveFile>
#include <QTimer>

using namespace Qt::StringLiterals;

namespace {

QString encoded(const QString &value)
{
    return QString::fromLatin1(QUrl::toPercentEncoding(value));
}

} // namespace

RestMoneyWorksLink::RestMoneyWorksLink(QString user, QString password, int timeoutSeconds)
    : m_user(std::move(user))
    , m_password(std::move(password))
    , m_timeoutSeconds(timeoutSeconds > 0 ? timeoutSeconds : 15)
{}

RestMoneyWorksLink::~RestMoneyWorksLink() = default;

MoneyWorksLink::Answer RestMoneyWorksLink::evaluate(const QString &expression)
{
    // Without an open document nothing is open: that is the answer, not an error.
    if (m_document.isEmpty() && expression == u"DocumentPath"_s)
        return {};
    return get(u"evaluate"_s, u"expr="_s + encoded(expression), MaxEvaluateBytes);
}

std::optional<DbError> RestMoneyWorksLink::openDocument(const QString &document)
{
    const QUrl address(document, QUrl::TolerantMode);
    const QString scheme = address.scheme().toLower();
    const QString name = address.path().mid(1);
    if ((scheme != u"http"_s && scheme != u"https"_s) || address.host().isEmpty() ||
        name.isEmpty()) {
        return DbError{NotADocumentError,
                       u"'%1' is not the address of a MoneyWorks document, such as "
                       u"http://server:6710/Acme.moneyworks."_s.arg(document)};
    }
    m_server = address.adjusted(QUrl::RemovePath | QUrl::RemoveQuery | QUrl::RemoveFragment |
                                QUrl::RemoveUserInfo);
    m_document = name;
    // The REST interface keeps no state: what "open" can do is make sure the document answers.
    const Answer answer =
        get(u"evaluate"_s, u"expr="_s + encoded(u"DocumentPath"_s), MaxEvaluateBytes);
    if (answer.error) {
        m_document.clear();
        return answer.error;
    }
    return std::nullopt;
}

std::optional<DbError> RestMoneyWorksLink::exportRecords(const QString &sortField,
                                                         const QString &search,
                                                         const QString &outputFile)
{
    // The server fills the template in once per record and adds nothing: no line of column
    // names, each line ended as the template ends it. The jobs file is read as a header line
    // and records, lines ended by CR LF, so it is written in that form.
    const Answer answer =
        get(u"export"_s,
            u"table=transaction&search="_s + encoded(search) + u"&sort="_s + encoded(sortField) +
                u"&format="_s + encoded(u"[TheirRef]\t[Detail.Account]\n"_s),
            MaxExportBytes);
    if (answer.error)
        return answer.error;
    QStringList lines{u"theirref\tu.detail.account"_s};
    for (const QString &line : answer.text.split(u'\n', Qt::SkipEmptyParts)) {
        const QString record = line.endsWith(u'\r') ? line.chopped(1) : line;
        if (record.isEmpty())
            continue;
        // Each record is the two asked fields and the TAB between them; anything else is not
        // the export that was asked for, and counting it would invent jobs.
        if (record.count(u'\t') != 1) {
            return DbError{
                UnexpectedAnswerError,
                u"The MoneyWorks server's export is not the records asked for (a "
                u"reference and an account on each line); line %1 reads: %2"_s.arg(lines.size())
                    .arg(record.left(80))};
        }
        lines << record;
    }
    QSaveFile file(outputFile);
    const QByteArray bytes = (lines.join(u"\r\n"_s) + u"\r\n"_s).toUtf8();
    if (!file.open(QIODevice::WriteOnly) || file.write(bytes) != bytes.size() || !file.commit())
        return DbError{75, u"Cannot write %1: %2"_s.arg(outputFile, file.errorString())};
    return std::nullopt;
}

MoneyWorksLink::Answer RestMoneyWorksLink::get(const QString &command, const QString &parameters,
                                               qint64 maxBytes)
{
    if (m_document.isEmpty())
        return {{}, DbError{NotADocumentError, u"No MoneyWorks document is open."_s}};
    if (!m_network)
        m_network = std::make_unique<QNetworkAccessManager>();

    QUrl url = m_server;
    url.setPath(u"/REST/"_s + encoded(m_document) + u'/' + command + u'/' + parameters,
                QUrl::TolerantMode);
    QNetworkRequest request(url);
    request.setRawHeader("Authorization",
                         "Basic " + (m_user + u':' + m_password).toUtf8().toBase64());
    request.setAttribute(QNetworkRequest::RedirectPolicyAttribute,
                         QNetworkRequest::NoLessSafeRedirectPolicy);

    std::unique_ptr<QNetworkReply> reply(m_network->get(request));
    QEventLoop loop;
    QTimer timer;
    timer.setSingleShot(true);
    bool timedOut = false;
    // The answer is taken as it arrives, and no further than the limit: a server that sends
    // without end must not fill the memory or the disk.
    QByteArray received;
    bool tooLarge = false;
    const auto take = [&] {
        received += reply->read(maxBytes + 1 - received.size());
        if (received.size() > maxBytes && !tooLarge) {
            tooLarge = true;
            reply->abort();
        }
    };
    QObject::connect(reply.get(), &QNetworkReply::readyRead, &loop, take);
    QObject::connect(reply.get(), &QNetworkReply::finished, &loop, &QEventLoop::quit);
    QObject::connect(&timer, &QTimer::timeout, &loop, [&] {
        timedOut = true;
        loop.quit();
    });
    timer.start(m_timeoutSeconds * 1000);
    if (!reply->isFinished())
        loop.exec(QEventLoop::ExcludeUserInputEvents);

    if (timedOut) {
        reply->abort();
        return {{},
                DbError{TimeoutError, u"The MoneyWorks server at %1 did not answer within %2 "
                                      u"seconds."_s.arg(m_server.toDisplayString())
                                          .arg(m_timeoutSeconds)}};
    }
    if (!tooLarge)
        take();
    if (tooLarge) {
        return {{},
                DbError{AnswerTooLargeError,
                        u"The MoneyWorks server at %1 sent more than %2 bytes for one answer; "
                        u"it is not an answer Veltrix asked for."_s.arg(m_server.toDisplayString())
                            .arg(maxBytes)}};
    }
    const int status = reply->attribute(QNetworkRequest::HttpStatusCodeAttribute).toInt();
    const QString body = QString::fromUtf8(received);
    if (status == 401)
        return {{}, DbError{401, u"The MoneyWorks server refused the user name or password."_s}};
    // The server's own words explain a refusal; when the transfer itself failed (a lost
    // connection, content that would not unpack) the body is no explanation.
    if (status >= 400) {
        const QString reason = body.trimmed().isEmpty() ? reply->errorString() : body.trimmed();
        return {{}, DbError{status, reason}};
    }
    if (reply->error() != QNetworkReply::NoError)
        return {{}, DbError{int(reply->error()), reply->errorString()}};
    return {body, std::nullopt};
}
