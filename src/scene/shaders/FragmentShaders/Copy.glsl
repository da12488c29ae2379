// A picture as it is.
uniform sampler2D t_Texture;

varying vec2 v_UV;

void main()
{
	gl_FragColor = texture2D(t_Texture, v_UV);
}
