" SPDX-License-Identifier: MIT
" LDraw part, model and multi-part files have the file type ldraw, which the language server
" quillmark-cli lsp serves. Another file type found first is kept (*.dat is a common extension).
autocmd BufRead,BufNewFile *.dat,*.ldr,*.mpd setfiletype ldraw
