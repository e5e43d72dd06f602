spectrel_library(spectrel_port_fixtures
    SOURCES
        ForkedPeer.cpp ForkedPeer.h
        RawPeer.cpp RawPeer.h)

spectrel_test(test_qt_platform
    SOURCES DiagnosticFileTest.cpp FileLogTest.cpp QtClockTest.cpp QtPreferencesTest.cpp QtRunLoopTest.cpp TerminationSignalsTest.cpp
    USES spectrel_qt spectrel_syslog spectrel_fakes spectrel_port_fixtures Qt6::DBus)

spectrel_test(test_message_ports
    SOURCES AllocationTest.cpp LocalPortTest.cpp PortFixture.h PortNameTest.cpp RemotePortTest.cpp WireTest.cpp
    USES spectrel_qt spectrel_ports spectrel_fakes spectrel_port_fixtures spectrel_counted_allocations)

spectrel_test(test_telephony_server
    SOURCES SocketTelephonyServerTest.cpp
    USES spectrel_ports spectrel_values spectrel_fakes)

spectrel_test(test_stream_inputs
    SOURCES StreamInputTest.cpp
    USES spectrel_qt spectrel_ports spectrel_fakes)
