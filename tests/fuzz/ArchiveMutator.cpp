// Changes archives as trees of fields, so that most of what the fuzzer tries is still a message.

#include <math.h>
#include <stdint.h>
#include <string.h>

#include <random>
#include <string>
#include <vector>

#include <Message.h>
#include <MessageForm.h>
#include <Point.h>
#include <Rect.h>

extern "C" size_t LLVMFuzzerMutate(uint8_t* data, size_t size, size_t maxSize);

namespace {

const char* const kClasses[] = { "BView", "BBox", "BButton", "BChannelSlider", "BCheckBox",
	"BColorControl", "BControl", "BDragger", "BListView", "BMenu", "BMenuBar", "BMenuField",
	"BMenuItem", "BOptionPopUp", "BOutlineListView", "BPictureButton", "BPopUpMenu", "BRadioButton",
	"BScrollBar", "BScrollView", "BSeparatorItem", "BSeparatorView", "BShape", "BShelf", "BSlider",
	"BStatusBar", "BStringItem", "BStringView", "BTab", "BTabView", "BTextControl", "BTextView",
	"BBitmap", "BCursor", "BHandler", "BLooper", "BWindow", "BAlert", "BApplication", "BitmapView",
	"LayoutInheritedView", "HiliteView", "Unknown", "A::Stranger", "_BMCMenuBar_", "_BTextInput_",
	"" };

const char* const kNames[] = { "class", "add_on", "_views", "_view_list", "_l_items", "_name",
	"_frame", "_resize_mode", "_flags", "_evmask", "_fname", "_fflt", "_color", "_uicolor",
	"_uitint", "_origin", "_psize", "_ploc", "_lmcapjoin", "_lmmiter", "_blend", "_dmod", "_show",
	"_label", "_val", "_msg", "_disable", "be:wants_nav", "_default", "_style", "_lblview", "_text",
	"_align", "_sel", "_items", "_min", "_max", "_minlbl", "_maxlbl", "_incrementvalue",
	"_hashcount", "_hashloc", "_sstyle", "_orient", "_bcolor", "_fcolor", "_bthickness", "_range",
	"_steps", "_prop", "_high", "_tlabel", "_ttext", "_divide", "_a_label", "_a_text", "_mod_msg",
	"_csize", "_col_sp", "_layout", "_use_off", "_but_width", "_trect", "_runs", "_max", "_dis_ch",
	"_nsel", "_nedit", "_wrap", "_auto_in", "_stylable", "_tab", "_rsize_to_fit", "_lv_type",
	"_l_full_items", "_li_expanded", "_li_outline_level", "_submenu", "_radio", "_marked",
	"_shortcut", "_mods", "_user_trig", "_dyn_label", "_maxwidth", "_trig_disabled", "_i_frames",
	"be:_m_channel_count", "be:_m_value_channel", "be:_m_channel_min", "be:_m_channel_max",
	"be:_m_channel_val", "be:_m_min_label", "_behave", "_labelview", "_orientation", "_halignment",
	"_valignment", "_rel", "_popup", "__widget", "_border", "_but_key", "_but_alert", "_mc_mb_",
	"_data", "_cspace", "_rowbytes", "_bmflags", "_title", "_wlook", "_wfeel", "_type", "_sizel",
	"_pulse", "bitmap", "_managed_archive", "_managed_archivable", "BView:layout", "stranger",
	"stranger 2", "stranger 3" };

constexpr float kReals[] = { 0, -0.0f, 1, -1, 0.5f, 12, 216, 1e9f, -1e9f, 1e30f, 3.5e9f, INFINITY,
	-INFINITY, NAN };
constexpr int64 kNumbers[] = { 0, 1, 2, 3, 4, 8, 12, 16, 0xff, 0x1202, -1, -2, 0x7f, 0x80, 0x7fff,
	0x8000, 0xffff, 0x10000, 0x7fffffff, 0x80000000ll, 0xffffffffll, INT64_MAX, INT64_MIN };


class Mutation {
public:
	Mutation(unsigned seed, size_t room) : fRandom(seed), fRoom(room) {}

	void Change(BMessage* message, int depth)
	{
		std::vector<std::string> fields;
		std::vector<std::string> nested;
		char* name;
		type_code type;
		for (int32 i = 0; message->GetInfo(B_ANY_TYPE, i, &name, &type) == B_OK; i++) {
			fields.push_back(name);
			if (type == B_MESSAGE_TYPE)
				nested.push_back(name);
		}
		if (!nested.empty() && depth < 40 && _Number(3) != 0) {
			const std::string& field = nested[_Number(nested.size())];
			const int32 index = _Item(*message, field);
			BMessage inner;
			if (message->FindMessage(field.c_str(), index, &inner) == B_OK) {
				Change(&inner, depth + 1);
				message->ReplaceMessage(field.c_str(), index, &inner);
				return;
			}
		}
		if (fields.empty() || _Number(4) == 0)
			_Add(message);
		else
			_ChangeField(message, fields[_Number(fields.size())]);
	}

private:
	size_t _Number(size_t limit) { return fRandom() % limit; }

	template<typename Value, size_t count> Value _Any(const Value (&values)[count])
	{
		return values[_Number(count)];
	}

	int32 _Item(const BMessage& message, const std::string& field)
	{
		type_code type;
		int32 count = 1;
		message.GetInfo(field.c_str(), &type, &count);
		return int32(_Number(size_t(count)));
	}

	void _ChangeField(BMessage* message, const std::string& field)
	{
		const char* name = field.c_str();
		const int32 index = _Item(*message, field);
		type_code type;
		int32 count = 0;
		message->GetInfo(name, &type, &count);
		const void* data;
		ssize_t size;
		if (message->FindData(name, type, index, &data, &size) != B_OK)
			return;
		switch (_Number(9)) {
			case 0:
				message->RemoveName(name);
				break;
			case 1:
				message->RemoveData(name, index);
				break;
			case 2:
				message->Rename(name, _Any(kNames));
				break;
			case 3: {
				const std::string copy(static_cast<const char*>(data), size_t(size));
				message->AddData(name, type, copy.data(), size, false);
				break;
			}
			case 4: {
				std::vector<uint8_t> bytes(
					static_cast<const uint8_t*>(data), static_cast<const uint8_t*>(data) + size);
				bytes.resize(bytes.size() + 16);
				const size_t length = LLVMFuzzerMutate(bytes.data(), size_t(size), bytes.size());
				message->ReplaceData(name, type, index, bytes.data(), ssize_t(length));
				break;
			}
			default:
				_Replace(message, name, type, index);
				break;
		}
	}

	void _Replace(BMessage* message, const char* name, type_code type, int32 index)
	{
		switch (type) {
			case B_STRING_TYPE:
				message->ReplaceString(
					name, index, strcmp(name, "class") == 0 ? _Any(kClasses) : _Text().c_str());
				break;
			case B_FLOAT_TYPE:
				message->ReplaceFloat(name, index, _Any(kReals));
				break;
			case B_RECT_TYPE:
				message->ReplaceRect(name, index, _Rect());
				break;
			case B_POINT_TYPE:
				message->ReplacePoint(name, index, BPoint(_Any(kReals), _Any(kReals)));
				break;
			case B_INT8_TYPE:
				message->ReplaceInt8(name, index, int8(_Any(kNumbers)));
				break;
			case B_INT16_TYPE:
				message->ReplaceInt16(name, index, int16(_Any(kNumbers)));
				break;
			case B_INT32_TYPE:
				message->ReplaceInt32(name, index, int32(_Any(kNumbers)));
				break;
			case B_BOOL_TYPE:
				message->ReplaceBool(name, index, _Number(2) == 0);
				break;
			default:
				break;
		}
	}

	void _Add(BMessage* message)
	{
		const char* name = _Any(kNames);
		switch (_Number(8)) {
			case 0:
				message->AddString(name, _Text().c_str());
				break;
			case 1:
				message->AddFloat(name, _Any(kReals));
				break;
			case 2:
				message->AddRect(name, _Rect());
				break;
			case 3:
				message->AddBool(name, true);
				break;
			case 4:
				message->AddInt16(name, int16(_Any(kNumbers)));
				break;
			case 5:
				_AddChild(message, _Number(3) == 0 ? name : "_views");
				break;
			default:
				message->AddInt32(name, int32(_Any(kNumbers)));
				break;
		}
	}

	void _AddChild(BMessage* message, const char* name)
	{
		// Now and then the message itself, which makes trees grow fast.
		if (_Number(4) == 0 && size_t(message->FlattenedSize()) * 2 < fRoom) {
			const BMessage copy(*message);
			message->AddMessage(name, &copy);
			return;
		}
		BMessage child;
		child.AddString("class", _Any(kClasses));
		child.AddRect("_frame", _Rect());
		child.AddInt32("_flags", int32(_Any(kNumbers)));
		message->AddMessage(name, &child);
	}

	BRect _Rect()
	{
		return _Number(2) == 0 ? BRect(5, 5, 60, 40)
							   : BRect(_Any(kReals), _Any(kReals), _Any(kReals), _Any(kReals));
	}

	std::string _Text()
	{
		switch (_Number(5)) {
			case 0:
				return _Any(kClasses);
			case 1:
				return "_tv_";
			case 2:
				return std::string(_Number(200), 'x');
			case 3:
				return "caf\303\251\n\t\377";
			default:
				return _Any(kNames);
		}
	}

	std::minstd_rand fRandom;
	const size_t fRoom;
};

} // namespace


extern "C" size_t
LLVMFuzzerCustomMutator(uint8_t* data, size_t size, size_t maxSize, unsigned seed)
{
	BMessage message;
	if (seed % 16 == 0 || unflatten_message(&message, data, size) != B_OK)
		return LLVMFuzzerMutate(data, size, maxSize);
	Mutation mutation(seed, maxSize);
	for (unsigned i = 0; i <= seed % 3; i++)
		mutation.Change(&message, 0);
	const message_form form = seed % 5 == 0 ? B_HAIKU_FORM : B_R5_FORM;
	const ssize_t newSize = flattened_message_size(message, form);
	if (newSize <= 0 || size_t(newSize) > maxSize
		|| flatten_message(message, form, reinterpret_cast<char*>(data), newSize) != B_OK)
		return LLVMFuzzerMutate(data, size, maxSize);
	return size_t(newSize);
}
