#include "backend/qt/QtMime.h"

#include <unistd.h>

#include <QUrl>

#include <TypeConstants.h>

namespace BPrivate {

namespace {

constexpr const char* kPlainText = "text/plain";
constexpr const char* kUtf8Text = "text/plain;charset=utf-8";
constexpr const char* kFileList = "text/uri-list";


QByteArray
SessionName(int32 session)
{
	return QByteArray::number(static_cast<qlonglong>(getpid())) + ':'
		+ QByteArray::number(static_cast<int>(session));
}


// The types of text that other programs use stand for our one.
std::string
OwnType(const QString& type)
{
	return type == QLatin1String(kUtf8Text) ? kPlainText : type.toStdString();
}

} // namespace


OfferMimeData::OfferMimeData(const DataOffer& offer, int32 session) :
	fOffer(offer), fSession(session)
{
}


QStringList
OfferMimeData::formats() const
{
	QStringList formats;
	if (fSession != 0)
		formats << QString::fromLatin1(kSessionType);
	for (const std::string& type : fOffer.types) {
		if (type == kPlainText)
			formats << QString::fromLatin1(kUtf8Text);
		formats << QString::fromStdString(type);
	}
	return formats;
}


bool
OfferMimeData::hasFormat(const QString& type) const
{
	return formats().contains(type);
}


QVariant
OfferMimeData::retrieveData(const QString& type, QMetaType preferred) const
{
	if (type == QLatin1String(kSessionType))
		return SessionName(fSession);

	std::string data;
	if (!hasFormat(type) || !fOffer.get || !fOffer.get(OwnType(type), &data))
		return QVariant();
	const QByteArray bytes(data.data(), static_cast<qsizetype>(data.size()));
	if (preferred.id() == QMetaType::QString)
		return QString::fromUtf8(bytes);
	if (preferred.id() == QMetaType::QVariantList && type == QLatin1String(kFileList)) {
		QVariantList urls;
		for (const QByteArray& line : bytes.split('\n')) {
			if (!line.trimmed().isEmpty())
				urls << QUrl::fromEncoded(line.trimmed());
		}
		return urls;
	}
	return bytes;
}


int32
session_of(const QMimeData& data)
{
	const QString type = QString::fromLatin1(kSessionType);
	if (!data.hasFormat(type))
		return 0;
	const QList<QByteArray> parts = data.data(type).split(':');
	if (parts.size() != 2 || parts[0].toLongLong() != static_cast<qlonglong>(getpid()))
		return 0;
	return static_cast<int32>(parts[1].toInt());
}


BMessage
message_of(const QMimeData& data)
{
	BMessage message;
	for (const char* type : { kFileList, kPlainText }) {
		const QByteArray bytes = type == kFileList ? data.data(QString::fromLatin1(type))
			: data.hasText()                       ? data.text().toUtf8()
												   : QByteArray();
		if (!bytes.isEmpty())
			message.AddData(type, B_MIME_TYPE, bytes.constData(), bytes.size(), false);
	}
	return message;
}


DataOffer
offer_of(const QMimeData* data)
{
	DataOffer offer;
	if (data == nullptr)
		return offer;
	for (const QString& format : data->formats())
		offer.types.push_back(format.toStdString());
	offer.get = [data](const std::string& type, std::string* _data) {
		if (type == kPlainText) {
			if (!data->hasText())
				return false;
			*_data = data->text().toStdString();
			return true;
		}
		const QString format = QString::fromStdString(type);
		if (!data->hasFormat(format))
			return false;
		*_data = data->data(format).toStdString();
		return true;
	};
	return offer;
}


} // namespace BPrivate
