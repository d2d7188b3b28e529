// QtMime: data that other programs ask for, and data of theirs.
#pragma once

#include <QMimeData>

#include "backend/Backend.h"

namespace BPrivate {

// Names a drag of this program that comes home: the process and the session.
constexpr const char* kSessionType = "application/x-vnd.archway-drag";


// Asks the offer only when somebody wants the data.
class OfferMimeData : public QMimeData {
public:
	// Session 0 for the clipboard.
	explicit OfferMimeData(const DataOffer& offer, int32 session = 0);

	QStringList formats() const override;
	bool hasFormat(const QString& type) const override;

protected:
	QVariant retrieveData(const QString& type, QMetaType preferred) const override;

private:
	DataOffer fOffer;
	int32 fSession;
};


// Of a drag that this program has started; 0 for others.
int32 session_of(const QMimeData& data);
// Files and text of another program's drag, in fields named by their types.
BMessage message_of(const QMimeData& data);
// Valid as long as the data are.
DataOffer offer_of(const QMimeData* data);


} // namespace BPrivate
