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


TEST(Port, TellsAboutItself)
{
	const port_id id = create_port(5, "told");
	ASSERT_EQ(B_OK, write_port(id, 1, nullptr, 0));
	ASSERT_EQ(B_OK, write_port(id, 2, nullptr, 0));
	read_port(id, nullptr, nullptr, 0);
	port_info info;
	ASSERT_EQ(B_OK, get_port_info(id, &info));
	EXPECT_STREQ("told", info.name);
	EXPECT_EQ(5, info.capacity);
	EXPECT_EQ(1, info.queue_count);
	EXPECT_EQ(2, info.total_count);

	bool found = false;
	for (int32 cookie = 0; get_next_port_info(B_CURRENT_TEAM, &cookie, &info) == B_OK;)
		found |= info.port == id;
	EXPECT_TRUE(found);
	EXPECT_EQ(B_OK, set_port_owner(id, info.team));
	EXPECT_EQ(B_BAD_TEAM_ID, set_port_owner(id, -5));
	delete_port(id);
	EXPECT_EQ(B_BAD_PORT_ID, get_port_info(id, &info));
	EXPECT_EQ(B_BAD_PORT_ID, set_port_owner(id, B_CURRENT_TEAM));
}


TEST(Area, ACloneIsTheSameMemory)
{
	void* address = nullptr;
	const area_id id = create_area(
		"mine", &address, B_ANY_ADDRESS, B_PAGE_SIZE, B_NO_LOCK, B_READ_AREA | B_WRITE_AREA);
	ASSERT_LT(0, id);
	void* same = nullptr;
	const area_id clone = clone_area("clone", &same, B_ANY_ADDRESS, B_READ_AREA, id);
	ASSERT_LT(0, clone);
	EXPECT_NE(address, same);
	static_cast<char*>(address)[7] = 'x';
	EXPECT_EQ('x', static_cast<char*>(same)[7]);
	EXPECT_EQ(B_ERROR, resize_area(id, 2 * B_PAGE_SIZE));
	EXPECT_EQ(B_OK, delete_area(id));
	EXPECT_EQ('x', static_cast<char*>(same)[7]);
	EXPECT_EQ(B_OK, delete_area(clone));
	EXPECT_EQ(B_BAD_VALUE, clone_area("none", &same, B_ANY_ADDRESS, B_READ_AREA, id));
}


TEST(Area, ChangesItsSizeAndProtection)
{
	void* address = nullptr;
	const area_id id = create_area("changing", &address, B_ANY_ADDRESS, 4 * B_PAGE_SIZE, B_NO_LOCK,
		B_READ_AREA | B_WRITE_AREA);
	ASSERT_LT(0, id);
	static_cast<char*>(address)[0] = 'x';
	EXPECT_EQ(B_BAD_VALUE, resize_area(id, 100));
	EXPECT_EQ(B_OK, resize_area(id, 2 * B_PAGE_SIZE));
	EXPECT_EQ(B_OK, set_area_protection(id, B_READ_AREA));
	area_info info;
	ASSERT_EQ(B_OK, get_area_info(id, &info));
	EXPECT_EQ(size_t(2 * B_PAGE_SIZE), info.size);
	EXPECT_EQ(uint32(B_READ_AREA), info.protection);
	EXPECT_EQ('x', static_cast<char*>(address)[0]);

	bool found = false;
	for (ssize_t cookie = 0; get_next_area_info(B_CURRENT_TEAM, &cookie, &info) == B_OK;)
		found |= info.area == id;
	EXPECT_TRUE(found);
	delete_area(id);
	EXPECT_EQ(B_BAD_VALUE, set_area_protection(id, B_READ_AREA));
}
