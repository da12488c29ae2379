// A window with one QQuickWidget that is empty but for knowing Qt Quick Controls, up to its first picture.
#include "FirstPicture.h"

#include <QApplication>
#include <QMainWindow>
#include <QQmlComponent>
#include <QQmlEngine>
#include <QQuickWidget>

int main(int i_Count, char** i_ppArguments)
{
	TellFirstPicture();
	QApplication application(i_Count, i_ppArguments);
	QMainWindow window;
	auto* const pView = new QQuickWidget;
	QQmlComponent component(pView->engine());
	component.setData("import QtQuick 2.15\nimport QtQuick.Controls 2.15\nItem {}", {});
	pView->setContent({}, &component, component.create());
	window.setCentralWidget(pView);
	window.resize(1280, 720);
	window.show();
	return QApplication::exec();
}
