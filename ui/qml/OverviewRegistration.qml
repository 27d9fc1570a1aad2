import QtQuick
import Kelvo.Ui

// How the phone is registered, its data contexts and their rates.
OverviewCard {
    id: card

    required property OverviewController overview

    objectName: "overviewRegistration"
    title: qsTr("Registration and data")
    visible: overview.registration.most + overview.data.most > 0

    Column {
        x: 14
        width: card.width - 28

        FactRows {
            width: parent.width
            rows: card.overview.registration
        }
        FactRows {
            id: data
            width: parent.width
            rows: card.overview.data
        }
        Item {
            width: 1
            height: Math.ceil((card.overview.data.most - card.overview.data.count) / data.columns) * 30
        }
    }
}
