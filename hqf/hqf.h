/// Everything that a user of the class interface needs: the model classes and the runtime under them.
#pragma once

#include "hqf/document/XMLDocumentResult.h"
#include "hqf/errors/c_error.h"
#include "hqf/errors/c_lmx_exception.h"
#include "hqf/errors/elmx_error.h"
#include "hqf/model/classes.h"
