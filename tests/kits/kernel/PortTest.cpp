#include <cstring>

#include <gtest/gtest.h>

#include <OS.h>


TEST(Port, KeepsMessagesInOrder)
{
	const port_id port = create_port(2, "a port");
	ASSERT_LT(0, port);
	EXPECT_EQ(port, find_port("a port"));
	EXPECT_EQ(B_OK, write_port(port, 1, "one", 4));
	EXPECT_EQ(B_OK, write_port(port, 2, nullptr, 0));
	EXPECT_EQ(2, port_count(port));
	EXPECT_EQ(B_WOULD_BLOCK, write_port_etc(port, 3, "x", 1, B_RELATIVE_TIMEOUT, 0));
	EXPECT_EQ(4, port_buffer_size(port));
	int32 code = 0;
	char buffer[8] = "";
	EXPECT_EQ(4, read_port(port, &code, buffer, sizeof(buffer)));
	EXPECT_EQ(1, code);
	EXPECT_STREQ("one", buffer);
	EXPECT_EQ(0, read_port(port, &code, buffer, sizeof(buffer)));
	EXPECT_EQ(2, code);
	EXPECT_EQ(
		B_TIMED_OUT, read_port_etc(port, &code, buffer, sizeof(buffer), B_RELATIVE_TIMEOUT, 1000));
	EXPECT_EQ(B_OK, delete_port(port));
	EXPECT_EQ(B_BAD_PORT_ID, write_port(port, 1, "x", 1));
}


TEST(Port, IsReadToItsEndAfterClosing)
{
	const port_id port = create_port(4, "closing");
	write_port(port, 5, "text", 5);
	EXPECT_EQ(B_OK, close_port(port));
	EXPECT_EQ(B_BAD_PORT_ID, write_port(port, 6, "late", 5));
	int32 code;
	char buffer[2];
	EXPECT_EQ(2, read_port(port, &code, buffer, sizeof(buffer)));
	EXPECT_EQ(5, code);
	EXPECT_EQ(B_BAD_PORT_ID, read_port(port, &code, buffer, sizeof(buffer)));
	delete_port(port);
}


TEST(Port, ReaderAndWriterWaitForEachOther)
{
	static port_id sPort;
	sPort = create_port(1, "narrow");
	const thread_id writer = spawn_thread(
		[](void*) -> status_t {
			for (int32 i = 0; i < 1000; i++) {
				if (write_port(sPort, i, &i, sizeof(i)) != B_OK)
					return B_ERROR;
			}
			return B_OK;
		},
		"writer", 10, nullptr);
	resume_thread(writer);
	for (int32 i = 0; i < 1000; i++) {
		int32 code;
		int32 value;
		ASSERT_EQ(ssize_t(sizeof(value)), read_port(sPort, &code, &value, sizeof(value)));
		ASSERT_EQ(i, code);
		ASSERT_EQ(i, value);
	}
	status_t result = B_ERROR;
	wait_for_thread(writer, &result);
	EXPECT_EQ(B_OK, result);
	delete_port(sPort);
}


TEST(Area, IsZeroedMemory)
{
	void* address = nullptr;
	const area_id area = create_area(
		"an area", &address, B_ANY_ADDRESS, 2 * B_PAGE_SIZE, B_NO_LOCK, B_READ_AREA | B_WRITE_AREA);
	ASSERT_LT(0, area);
	char* bytes = static_cast<char*>(address);
	EXPECT_EQ(0, bytes[2 * B_PAGE_SIZE - 1]);
	bytes[100] = 'x';
	EXPECT_EQ(area, area_for(bytes + B_PAGE_SIZE + 5));
	EXPECT_EQ(area, find_area("an area"));
	area_info info;
	EXPECT_EQ(B_OK, get_area_info(area, &info));
	EXPECT_EQ(address, info.address);
	EXPECT_EQ(size_t(2 * B_PAGE_SIZE), info.size);
	EXPECT_EQ(B_OK, delete_area(area));
	EXPECT_EQ(B_ERROR, area_for(bytes));
	EXPECT_EQ(
		B_BAD_VALUE, create_area("odd", &address, B_ANY_ADDRESS, 100, B_NO_LOCK, B_READ_AREA));
}
