// arcv convert: writes messages in another form.

#include <memory>

#include "tools/arcv/Command.h"
#include "tools/arcv/Edit.h"
#include "tools/arcv/Forms.h"
#include "tools/arcv/Input.h"
#include "tools/arcv/Output.h"
#include "tools/arcv/TypeCode.h"

namespace Arcv {

namespace {

struct ConvertOptions {
	std::string file;
	std::string output;
	message_form form = B_R5_FORM;
};


bool
Flatten(const BMessage& message, message_form form, std::string* _bytes)
{
	const ssize_t size = flattened_message_size(message, form);
	if (size < 0)
		return false;
	_bytes->resize(size);
	return flatten_message(message, form, _bytes->data(), size) == B_OK;
}


int
ConvertMessage(const Input& input, const ConvertOptions& options)
{
	std::string bytes;
	if (!Flatten(input.Message(), options.form, &bytes)) {
		Complain(options.file, "the message cannot be written in this form");
		return kUnreadable;
	}
	const std::string& target = options.output.empty() ? options.file : options.output;
	return WriteWholeFile(target, bytes) ? kFine : kUnreadable;
}


// Each message keeps its place among the items; one that has the form already stays untouched.
int
ConvertItems(BResources& resources, const ConvertOptions& options)
{
	type_code type;
	int32 id;
	const char* name;
	size_t size;
	BResources converted;
	for (int32 i = 0; resources.GetResourceInfo(i, &type, &id, &name, &size); i++) {
		if (converted.HasResource(type, id)) {
			Complain(options.file,
				"there are two of " + ItemText(type, id)
					+ "; arcv check --repair tells them apart");
			return kUnreadable;
		}
		const void* data = resources.LoadResource(type, id, &size);
		BMessage message;
		message_form form;
		std::string bytes;
		if (data == NULL) {
			Complain(options.file, "the bytes of " + ItemText(type, id) + " cannot be read");
			return kUnreadable;
		}
		if (!IsMessage(data, size, &message, &form) || form == options.form)
			bytes.assign(static_cast<const char*>(data), size);
		else if (!Flatten(message, options.form, &bytes)) {
			Complain(options.file, ItemText(type, id) + " cannot be written in this form");
			return kUnreadable;
		}
		converted.AddResource(type, id, bytes.data(), bytes.size(), name[0] != '\0' ? name : NULL);
	}

	// Adding a known key moves it to the end: all of them in turn keep their order.
	for (int32 i = 0; converted.GetResourceInfo(i, &type, &id, &name, &size); i++) {
		const void* data = converted.LoadResource(type, id, &size);
		const status_t status =
			resources.AddResource(type, id, data, size, name[0] != '\0' ? name : NULL);
		if (status != B_OK) {
			Complain(options.file, StatusText(status));
			return kUnreadable;
		}
	}
	return kFine;
}


int
RunConvert(const ConvertOptions& options)
{
	Input input;
	if (!input.Open(options.file))
		return kUnreadable;
	if (input.IsMessage())
		return ConvertMessage(input, options);
	return EditFile(options.file, options.output, false,
		[&](BResources& resources) { return ConvertItems(resources, options); });
}

} // namespace


void
AddConvertCommand(CLI::App& app, int* _status)
{
	const auto options = std::make_shared<ConvertOptions>();
	CLI::App* command =
		app.add_subcommand("convert", "Write the messages of a file in another form");
	command->add_option("file", options->file, "A resource file, or one flattened message")
		->required();
	command->add_option("-f,--form", options->form, "r5, r5-wide or haiku")
		->required()
		->transform(CLI::CheckedTransformer(WritableForms()));
	command->add_option("-o,--output", options->output, "Write a new file instead");
	command->callback([=] { *_status = RunConvert(*options); });
}

} // namespace Arcv
