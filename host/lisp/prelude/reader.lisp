;;; ECL's readers of `#p` and `#1=` use what comes next without asking whether anything does: at the end of a
;;; text that is cut short there, they end the process.

(in-package "TESSEL-HOST")

(defun read-pathname (stream subcharacter argument)
  (declare (ignore subcharacter argument))
  (let ((name (read stream t nil t)))
    (unless *read-suppress* (values (parse-namestring name)))))

(defun block-comment-next-p (stream)
  (when (char= (peek-char nil stream t nil t) #\#)
    (read-char stream t nil t)
    (prog1 (eql (peek-char nil stream nil nil t) #\|)
      (unread-char #\# stream))))

(defun expect-object (stream readtable)
  "Fails as every reader does where nothing but space and comments is left."
  (loop
    (cond ((char= (peek-char t stream t nil t) #\;)
           (read-line stream t nil t))
          ((block-comment-next-p stream)
           (read-char stream t nil t)
           (read-char stream t nil t)
           (funcall (get-dispatch-macro-character #\# #\| readtable) stream #\| nil))
          (t (return)))))

(defun mended (readtable)
  "The readtable itself."
  (let ((read-labelled (get-dispatch-macro-character #\# #\= readtable)))
    (set-dispatch-macro-character #\# #\P #'read-pathname readtable)
    (set-dispatch-macro-character #\# #\= (lambda (stream subcharacter label)
                                            (expect-object stream readtable)
                                            (values (funcall read-labelled stream subcharacter label)))
                                  readtable))
  readtable)
