// arcv compile: a resource file from text.

#include <memory>

#include <File.h>

#include "tools/arcv/Command.h"
#include "tools/arcv/Edit.h"
#include "tools/arcv/Forms.h"
#include "tools/arcv/Input.h"
#include "tools/arcv/Output.h"
#include "tools/arcv/rdef/Compiler.h"

namespace Arcv {

namespace {

struct CompileArguments {
	std::vector<std::string> files;
	std::string output;
	CompileOptions options;
};


void
ComplainOfLine(const RdefError& error, const char* kind)
{
	Complain(error.file, "line " + std::to_string(error.line) + ": " + kind + error.reason);
}


int
CompileInto(BResources& resources, const CompileArguments& arguments)
{
	Compiler compiler(arguments.options, resources);
	for (const std::string& file : arguments.files) {
		std::string text;
		if (!ReadWholeFile(file, &text))
			return kUnreadable;
		const bool fine = compiler.Compile(file, text);
		if (!fine) {
			ComplainOfLine(compiler.Error(), "");
			return kUnreadable;
		}
	}
	for (const RdefError& warning : compiler.Warnings())
		ComplainOfLine(warning, "warning: ");
	return kFine;
}


int
MergeInto(BResources& target, BResources& compiled, const std::string& file)
{
	type_code type;
	int32 id;
	const char* name;
	size_t size;
	for (int32 i = 0; compiled.GetResourceInfo(i, &type, &id, &name, &size); i++) {
		const void* data = compiled.LoadResource(type, id, &size);
		const status_t status =
			target.AddResource(type, id, data, size, name[0] != '\0' ? name : NULL);
		if (status != B_OK) {
			Complain(file, StatusText(status));
			return kUnreadable;
		}
	}
	return kFine;
}


int
RunCompile(const CompileArguments& arguments)
{
	BResources resources;
	const int status = CompileInto(resources, arguments);
	if (status != kFine)
		return status;
	const std::string& output = arguments.output;
	if (arguments.options.merge && Exists(output))
		return EditFile(output, "", false,
			[&](BResources& target) { return MergeInto(target, resources, output); });

	// What the file holds is given up only now that there is something for its place.
	BFile file(output.c_str(), B_READ_WRITE | B_CREATE_FILE);
	BResources old;
	status_t error = file.InitCheck();
	if (error == B_OK && old.SetTo(&file) != B_OK)
		error = old.SetTo(&file, true);
	if (error == B_OK)
		error = resources.WriteTo(&file);
	if (error == B_OK)
		return kFine;
	Complain(output, StatusText(error));
	return kUnreadable;
}

} // namespace


void
AddCompileCommand(CLI::App& app, int* _status)
{
	const auto arguments = std::make_shared<CompileArguments>();
	CLI::App* command =
		app.add_subcommand("compile", "Make a resource file of resource definition text");
	command->add_option("files", arguments->files, "The texts")->required();
	command->add_option("-o,--output", arguments->output, "The resource file")->required();
	command
		->add_option("-I,--include", arguments->options.includeFolders,
			"A folder of files that are included or imported")
		->allow_extra_args(false);
	command->add_option("-f,--form", arguments->options.form, "r5 (the default), r5-wide or haiku")
		->transform(CLI::CheckedTransformer(WritableForms()));
	command->add_flag("-m,--merge", arguments->options.merge,
		"Keep the resources that the file has, and replace those of the same type and id");
	command->add_flag("--auto-names", arguments->options.autoNames,
		"Name resources by the symbols that are their ids");
	command->callback([=] { *_status = RunCompile(*arguments); });
}

} // namespace Arcv
