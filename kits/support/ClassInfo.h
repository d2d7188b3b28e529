// Names and casts of dynamic classes, in the manner of old sources.
#pragma once

#include <typeinfo>

#define class_name(object) (typeid(*(object)).name())
#define cast_as(object, Class) (dynamic_cast<Class*>(object))
#define is_kind_of(object, Class) (dynamic_cast<Class*>(object) != NULL)
#define is_instance_of(object, Class) (typeid(*(object)) == typeid(Class))
