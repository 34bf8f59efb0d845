"""Scripts have no .py at their end, so that plain imports do not find them."""
import importlib.machinery
import importlib.util
import pathlib
import sys

SCRIPTS = pathlib.Path(__file__).resolve().parents[2] / "scripts"


def load(name):
    sys.dont_write_bytecode = True
    sys.path.insert(0, str(SCRIPTS))
    loader = importlib.machinery.SourceFileLoader(name.replace("-", "_"), str(SCRIPTS / name))
    module = importlib.util.module_from_spec(importlib.util.spec_from_loader(loader.name, loader))
    loader.exec_module(module)
    return module
