// The colour as it is, without light.
varying vec4 v_Colour;

void main()
{
	gl_FragColor = v_Colour;
}
