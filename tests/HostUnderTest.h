#pragma once

/// Tests of controls run on the headless host, and the same tests again on the host for Qt: they name it `test::HostUnderTest`.
#ifdef TESSEL_TESTED_ON_QT
#include "tests/hosts/qt/QtTestHost.h"
namespace tessel::test {
using HostUnderTest = qt::test::QtTestHost;
}
#else
#include "hosts/headless/HeadlessHost.h"
namespace tessel::test {
using HostUnderTest = headless::HeadlessHost;
}
#endif
