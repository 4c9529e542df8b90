// Veltrix — KPI dashboard for small businesses.
#pragma once

#include "moneyworkslink.h"

#include <QUrl>

#include <memory>

class QNetworkAccessManager;

// MoneyWorks Datacentre reached through its REST interface: every call is one HTTP(S) GET of
// /REST/<document>/<command>/<parameters> with basic authentication, waited for at most the
// given number of seconds. A document is named by its address, for example
// http://server:6710/Acme%20Repairs.moneyworks.
class RestMoneyWorksLink final : public MoneyWorksLink
{
public:
    RestMoneyWorksLink(QString user, QString password, int timeoutSeconds);
    ~RestMoneyWorksLink() override;

    Answer evaluate(const QString &expression) override;
    std::optional<DbError> openDocument(const QString &document) override;
    std::optional<DbError> exportRecords(const QString &sortField, const QString &search,
                                         const QString &outputFile) override;

    static constexpr qint32 TimeoutError = -2147023436;
    static constexpr qint32 NotADocumentError = 53;

    // The most read for one answer: an expression's value is a line of text; an export is one
    // short line per invoice line, and a shop's year of them stays far below this.
    static constexpr qint64 MaxEvaluateBytes = 64 * 1024;
    static constexpr qint64 MaxExportBytes = 32 * 1024 * 1024;

private:
    Answer get(const QString &command, const QString &parameters, qint64 maxBytes);

    QString m_user;
    QString m_password;
    int m_timeoutSeconds;
    QUrl m_server;
    QString m_document;
    std::unique_ptr<QNetworkAccessManager> m_network;
};
