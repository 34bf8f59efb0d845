"""Scripts have no .py at their end, so that plain imports do not find them."""
import importlib.machinery
import pathlib
import sys
import types

SCRIPTS = pathlib.Path(__file__).resolve().parents[2] / "scripts"


def load(name):
    sys.dont_write_bytecode = True
    sys.path.insert(0, str(SCRIPTS))
    loader = importlib.machinery.SourceFileLoader(name.replace("-", "_"), str(SCRIPTS / name))
    module = types.ModuleType(loader.name)
    module.__file__ = loader.path
    loader.exec_module(module)
    return module
